// getProductBinPath against a real process environment: a child process (binpath_probe) reads the
// example site's ApplicationLocation document and looks its processes' folders up in the
// environment it was started with.
#include <gtest/gtest.h>

#include <cstdlib>
#include <map>
#include <string>

#include "ChildProcess.h"

namespace {

struct EnvironmentRow {
    const char* name;
    std::map<std::string, std::string> environment;
    const char* process;
    std::string expected;  // the folder printed; empty: none found
};

const std::string kStorage = "/opt/quorvex/storage/bin";
const std::string k2047(2047, 's');

const EnvironmentRow kRows[] = {
    {"PercentWrapped", {{"QUORVEX_STORAGE_BIN", kStorage}}, "QuorvexStorageServer", kStorage},
    {"Bare",
     {{"QUORVEX_WEB_BIN", "/opt/quorvex/web/bin"}},
     "QuorvexWebServer",
     "/opt/quorvex/web/bin"},
    {"Missing", {{"QUORVEX_STORAGE_BIN", kStorage}}, "QuorvexWebServer", ""},
    {"Empty", {{"QUORVEX_WEB_BIN", ""}}, "QuorvexWebServices", ""},
    {"LongestThatFits", {{"QUORVEX_STORAGE_BIN", k2047}}, "QuorvexArchiveServer", k2047},
    {"TooLong", {{"QUORVEX_STORAGE_BIN", k2047 + "s"}}, "QuorvexArchiveServer", ""},
    {"RecursiveIsNotExpanded",
     {{"QUORVEX_INTEGRATION_BIN", "%QUORVEX_STORAGE_BIN%"}, {"QUORVEX_STORAGE_BIN", kStorage}},
     "QuorvexIntegrationEngine",
     "%QUORVEX_STORAGE_BIN%"},
    {"NoProduct", {{"QUORVEX_STORAGE_BIN", kStorage}}, "QuorvexConfigTool", ""},
    {"NoApplication", {{"QUORVEX_STORAGE_BIN", kStorage}}, "NotInstalled", ""},
};

class ProductBinPathInEnvironment : public testing::TestWithParam<EnvironmentRow> {};

TEST_P(ProductBinPathInEnvironment, FolderFromTheChildsEnvironment) {
    // A variable the row does not set must be unset in the child, so it must be in this process.
    for (const char* name : {"QUORVEX_STORAGE_BIN", "QUORVEX_WEB_BIN", "QUORVEX_INTEGRATION_BIN"}) {
        ASSERT_EQ(nullptr, std::getenv(name)) << name << " is set around the test";
    }
    std::vector<std::string> args = {
        BINPATH_PROBE_BINARY, std::string(QUORVEX_EXAMPLES) + "/site/ApplicationLocation.xml",
        GetParam().process};
    IntegrationTesting::ChildProcess child(args, GetParam().environment);
    EXPECT_EQ(std::string(GetParam().process) + "=[" + GetParam().expected + "]",
              child.readLine(10000));
    EXPECT_EQ(0, child.wait(10000));
}

INSTANTIATE_TEST_SUITE_P(Rows, ProductBinPathInEnvironment, testing::ValuesIn(kRows),
                         [](const testing::TestParamInfo<EnvironmentRow>& info) {
                             return info.param.name;
                         });

}  // namespace
