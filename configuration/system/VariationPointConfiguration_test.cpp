#include "Configuration/VariationPointConfiguration__.h"

#include <gtest/gtest.h>

#include "testing/LogCapture.h"

namespace {

using Configuration::VariationPointConfiguration__;
using Quorvex::Testing::LogCapture;

const char kInvalidListMessage[] =
    "VariationPointConfiguration__::getStorageCommitServiceListValue(): Failed - configuration "
    "has invalid value for storage commit service list.\n";

std::string listValueFor(int number) {
    VariationPointConfiguration__ points;
    points.setStorageCommitServiceList(number);
    return points.getStorageCommitServiceListValue().c_str();
}

TEST(VariationPointStorageCommitList, DefaultOffersEveryStorageService) {
    LogCapture log;
    EXPECT_EQ(
        "All_Storage_Services_List",
        std::string(VariationPointConfiguration__().getStorageCommitServiceListValue().c_str()));
    EXPECT_EQ("All_Storage_Services_List_NO_STORAGE_COMMITMENT_PUSH", listValueFor(1));
    EXPECT_TRUE(log.records().empty());
}

TEST(VariationPointStorageCommitList, OtherNumbersGiveEmptyTextAndLogAnError) {
    for (const int number : {2, -1}) {
        LogCapture log;
        EXPECT_EQ("", listValueFor(number));
        EXPECT_TRUE(log.contains(LM_ERROR, kInvalidListMessage)) << number;
    }
}

TEST(VariationPointStorageCommitList, OnlyTheTwoStandardNamesAreNotCustom) {
    EXPECT_FALSE(VariationPointConfiguration__::isStorageCommitServiceListValueCustom(
        "All_Storage_Services_List"));
    EXPECT_FALSE(VariationPointConfiguration__::isStorageCommitServiceListValueCustom(
        "All_Storage_Services_List_NO_STORAGE_COMMITMENT_PUSH"));
    EXPECT_TRUE(VariationPointConfiguration__::isStorageCommitServiceListValueCustom(
        "all_storage_services_list"));
    EXPECT_TRUE(VariationPointConfiguration__::isStorageCommitServiceListValueCustom(""));
}

}  // namespace
