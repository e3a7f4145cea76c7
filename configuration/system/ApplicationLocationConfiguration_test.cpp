// Where a process's binaries lie: from the application to its product to the environment
// variable the product names. The environment here is a fake machine's; the real one is tested
// in a child process (tests/ProductBinPath_test.cpp).
#include <gtest/gtest.h>

#include <string>

#include "Configuration/ApplicationLocationConfiguration.h"
#include "testing/FakeMachine.h"
#include "testing/LogCapture.h"

namespace Configuration {
namespace {

const char kNoBinaryPath[] =
    "ApplicationLocationConfiguration::getProductBinPath: Could not find binary path for process "
    "%s\n";
const char kNotSet[] =
    "ApplicationLocationConfiguration::getProductBinPath: Environment Variable %s is not set. "
    "Please set this to its relevant solution bin folder:\n";

ApplicationDefinition application(const char* name, const char* productId) {
    ApplicationDefinition a;
    a.setName(name);
    a.setProductID(productId);
    return a;
}

ProductDefinition product(const char* id, const char* binaryPath) {
    ProductDefinition p;
    p.setID(id);
    p.setBinaryPath(binaryPath);
    return p;
}

// Applications and products in which each row's process finds its own road.
ApplicationLocationConfiguration solution() {
    ApplicationDefinitions applications;
    applications.setApplicationDefinitions({
        application("Bare", "P-BARE"),
        application("Wrapped", "P-WRAPPED"),
        application("Twice", "P-WRAPPED"),
        application("Twice", "P-BARE"),
        application("NoProductId", ""),
        application("UnknownProduct", "P-NONE"),
        application("EmptyBinaryPath", "P-EMPTY"),
        application("Percent", "P-PERCENT"),
        application("Unset", "P-UNSET"),
        application("EmptyValue", "P-EMPTYVALUE"),
        application("Long", "P-LONG"),
        application("TooLong", "P-TOOLONG"),
        application("Recursive", "P-RECURSIVE"),
        application("Unclosed", "P-UNCLOSED"),
    });
    ProductDefinitions products;
    products.setProductDefinitions({
        product("P-BARE", "QX_BIN"),
        product("P-WRAPPED", "%QX_BIN%"),
        product("P-BARE", "QX_OTHER"),  // a later product with the same ID is never reached
        product("P-EMPTY", ""),
        product("P-PERCENT", "%"),
        product("P-UNSET", "%QX_UNSET%"),
        product("P-EMPTYVALUE", "QX_EMPTY"),
        product("P-LONG", "QX_LONG"),
        product("P-TOOLONG", "QX_TOOLONG"),
        product("P-RECURSIVE", "%QX_A%"),
        product("P-UNCLOSED", "%QX_BIN"),
    });
    ApplicationLocationConfiguration config;
    config.setApplicationDefinitions(applications);
    config.setProductDefinitions(products);
    return config;
}

struct BinPathRow {
    const char* process;
    std::string expected;
    const char* message;     // null: nothing logged
    const char* messageArg;  // what the message names
};

const std::string kFolder = "/opt/quorvex/bin";
const std::string k2047(2047, 'x');

const BinPathRow kRows[] = {
    {"Bare", kFolder, nullptr, nullptr},
    {"Wrapped", kFolder, nullptr, nullptr},
    {"Twice", kFolder, nullptr, nullptr},  // the first application of that name decides
    {"Absent", "", kNoBinaryPath, "Absent"},
    {"bare", "", kNoBinaryPath, "bare"},  // names compare exactly
    {"NoProductId", "", kNoBinaryPath, "NoProductId"},
    {"UnknownProduct", "", kNoBinaryPath, "UnknownProduct"},  // the process, not the product
    {"EmptyBinaryPath", "", kNoBinaryPath, "EmptyBinaryPath"},
    {"Percent", "", kNotSet, ""},
    {"Unset", "", kNotSet, "QX_UNSET"},
    {"EmptyValue", "", kNotSet, "QX_EMPTY"},
    {"Long", k2047, nullptr, nullptr},
    {"TooLong", "", kNotSet, "QX_TOOLONG"},
    {"Recursive", "%QX_B%", nullptr, nullptr},  // the value as it stands, never expanded
    {"Unclosed", "", kNotSet, "QX_BI"},         // the last character goes without a test
};

class ProductBinPath : public testing::TestWithParam<BinPathRow> {};

TEST_P(ProductBinPath, FollowsApplicationProductAndVariable) {
    Quorvex::Testing::FakeMachine machine;
    machine.inheritEnvironment = false;
    machine.env = {{"QX_BIN", kFolder}, {"QX_OTHER", "/wrong"},      {"QX_EMPTY", ""},
                   {"QX_LONG", k2047},  {"QX_TOOLONG", k2047 + "x"}, {"QX_A", "%QX_B%"},
                   {"QX_B", "/never"}};
    Quorvex::ScopedMachine scoped(machine);
    Quorvex::Testing::LogCapture log;
    const BinPathRow& row = GetParam();
    EXPECT_EQ(row.expected, solution().getProductBinPath(row.process).c_str());
    if (row.message == nullptr) {
        EXPECT_TRUE(log.records().empty());
        return;
    }
    ASSERT_EQ(1u, log.records().size());
    std::string text = row.message;
    text.replace(text.find("%s"), 2, row.messageArg);
    EXPECT_TRUE(log.contains(LM_CRITICAL, text)) << log.records()[0].text;
}

INSTANTIATE_TEST_SUITE_P(Rows, ProductBinPath, testing::ValuesIn(kRows),
                         [](const testing::TestParamInfo<BinPathRow>& info) {
                             return std::string(info.param.process) +
                                    (info.param.process[0] == 'b' ? "Lower" : "");
                         });

}  // namespace
}  // namespace Configuration
