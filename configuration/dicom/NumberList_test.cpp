// The list syntax of transfer-syntax numbers, over texts that show each of its rules.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "NumberList.h"

namespace Configuration {
namespace {

std::vector<int> numbersOf(const std::string& text) {
    std::vector<int> numbers;
    NumberList::scan(text.data(), text.size(), [&](int nr) { numbers.push_back(nr); });
    return numbers;
}

TEST(NumberList, TextsGiveTheirNumbers) {
    const struct {
        std::string text;
        std::vector<int> numbers;
    } kCases[] = {
        {"", {}},
        {"1,2,3", {1, 2, 3}},
        {"1 2 3", {1, 2, 3}},
        {"1;2;3", {1, 2, 3}},
        {"1, 2", {1, 2}},                    // the blank is an empty token
        {"12a3", {12, 3}},                   // one character after the digits is the separator
        {"12ab3", {12, 3}},                  // the second letter an empty token
        {",,,", {}},                         // only empty tokens
        {"-5,+6", {5, 6}},                   // signs are not part of a number
        {"007", {7}},                        // leading zeros
        {"5,", {5}},                         // a trailing separator
        {"5", {5}},                          // no separator at the end
        {std::string("1\0002", 3), {1, 2}},  // a NUL byte is a separator like any other
        {"\xb2"
         "1\xb9"
         "2\xff",
         {1, 2}},  // bytes from 0x80 are never digits
        {"2147483647", {2147483647}},
        {"2147483648", {-2147483647 - 1}},  // 32-bit wrap-around, no overflow check
        {"4294967296", {0}},
        {"4294967297", {1}},
        {"99999999999", {1215752191}},  // 99999999999 mod 2^32
    };
    for (const auto& c : kCases) {
        EXPECT_EQ(numbersOf(c.text), c.numbers) << c.text;
    }
}

}  // namespace
}  // namespace Configuration
