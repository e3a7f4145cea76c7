#include "Configuration/RestartConfiguration__.h"

#include <gtest/gtest.h>

#include "ElementTestSupport.h"

namespace {

using Configuration::RestartConfiguration__;
using Configuration::Testing::childKeys;
using Configuration::Testing::childText;

TEST(RestartConfigurationElement, DefaultScheduleIsWrittenAsText) {
    const auto element = RestartConfiguration__().writeVesk();
    EXPECT_EQ("Restart", std::string(element->key().c_str()));
    EXPECT_EQ((std::vector<std::string>{"RestartTimeOfDay", "RestartNumberOfDaysBetween"}),
              childKeys(*element));
    EXPECT_EQ("02:00", childText(*element, "RestartTimeOfDay"));
    EXPECT_EQ("0", childText(*element, "RestartNumberOfDaysBetween"));
}

}  // namespace
