// The exception family, the error record and the element scanner of HttpConfigurationClient.
#include <gtest/gtest.h>

#include <string>

#include "Configuration/ErrorData.h"
#include "Configuration/HttpConfigurationClient.h"
#include "Configuration/HttpConfigurationException.h"

namespace Configuration {
namespace {

std::string whatOf(const std::exception& e) {
    return e.what();
}

// what() is the prefix, the message and only the fields each constructor was given; never the
// localized message.
TEST(HttpConfigurationException, WhatNamesOnlyTheGivenFields) {
    const std::pair<HttpConfigurationException, const char*> cases[] = {
        {HttpConfigurationException(""), "HttpConfigurationException: "},
        {HttpConfigurationException("boom"), "HttpConfigurationException: boom"},
        {HttpConfigurationException("K", "M"), "HttpConfigurationException: M ErrorKey: K"},
        {HttpConfigurationException("K", "M", "T", "L"),
         "HttpConfigurationException: M ErrorKey: K OriginalStackTrace: T"},
        {HttpConfigurationException("", "C", "M", "", ""),
         "HttpConfigurationException: M ErrorCode: C"},
        {HttpConfigurationException("K", "C", "M", "T", "L"),
         "HttpConfigurationException: M ErrorKey: K ErrorCode: C OriginalStackTrace: T"}};
    for (const auto& c : cases) {
        EXPECT_EQ(c.second, whatOf(c.first));
    }
    EXPECT_EQ("L", std::string(cases[3].first.LocalizedMessage().c_str()));
    EXPECT_TRUE(cases[3].first.Code().empty());
}

TEST(HttpConfigurationException, CopiesKeepTheTextAfterTheOriginalIsGone) {
    auto* original = new HttpConfigurationException("K", "C", "M", "T", "L");
    HttpConfigurationException copy(*original);
    HttpConfigurationException assigned("x");
    assigned = *original;
    delete original;
    EXPECT_EQ("HttpConfigurationException: M ErrorKey: K ErrorCode: C OriginalStackTrace: T",
              whatOf(copy));
    EXPECT_EQ(whatOf(copy), whatOf(assigned));
}

TEST(HttpConfigurationErrorData, LoadsEveryElementAndConvertsTheLocalizedMessage) {
    auto error = ErrorData::Create();
    error->LoadXml(
        "<Error><ErrorKey>K</ErrorKey><ErrorCode>42</ErrorCode><ErrorMessage>a &amp; b"
        "</ErrorMessage><LocalizedErrorMessage>Gr\xC3\xBC\xC3\x9F"
        "e</LocalizedErrorMessage><ErrorOriginalStackTrace>at x</ErrorOriginalStackTrace></Error>");
    EXPECT_EQ("K", std::string(error->ErrorKey.c_str()));
    EXPECT_EQ("42", std::string(error->ErrorCode.c_str()));
    EXPECT_EQ("a & b", std::string(error->ErrorMessage.c_str()));
    EXPECT_EQ(
        "Gr\xFC\xDF"
        "e",
        std::string(error->LocalizedErrorMessage.c_str()));
    EXPECT_EQ("at x", std::string(error->ErrorOriginalStackTrace.c_str()));
}

TEST(HttpConfigurationErrorData, MissingElementsKeepTheirPreviousValue) {
    auto error = ErrorData::Create();
    error->LoadXml("<ErrorKey>first</ErrorKey>");
    error->LoadXml("<ErrorCode>7</ErrorCode>");
    EXPECT_EQ("first", std::string(error->ErrorKey.c_str()));
    EXPECT_EQ("7", std::string(error->ErrorCode.c_str()));
    EXPECT_TRUE(error->ErrorMessage.empty());
}

struct Scan {
    bool found;
    std::string value;
    ACE_CString::size_type next;
};

Scan scan(const char* tag, const std::string& text, ACE_CString::size_type start = 0) {
    ACE_CString value("untouched");
    ACE_CString::size_type next = 12345;
    const bool found = HttpConfigurationClient::findElementText(
        tag, ACE_CString(text.c_str(), text.size()), start, value, next);
    return {found, value.c_str(), next};
}

TEST(HttpClientElementScanner, CutsTheTextBetweenTheMarksReplacingEntities) {
    const Scan s = scan("A", "<x><A>hello</A></x>");
    EXPECT_TRUE(s.found);
    EXPECT_EQ("hello", s.value);
    EXPECT_EQ(15u, s.next);  // just behind "</A>"
    EXPECT_EQ("a&b<c>", scan("A", "<A>a&amp;b&lt;c&gt;</A>").value);
    EXPECT_TRUE(scan("A", "<A></A>").found);
    EXPECT_EQ("", scan("A", "<A></A>").value);
    EXPECT_EQ("<A>inner", scan("A", "<A><A>inner</A></A>").value);  // the first closing mark
}

// Regression: next is counted with the replaced (shorter) value, so it lands inside the element.
TEST(HttpClientElementScanner, NextCountsTheReplacedLength) {
    const std::string text = "<A>&amp;&amp;</A><A>2</A>";
    const Scan first = scan("A", text);
    EXPECT_EQ("&&", first.value);
    EXPECT_EQ(3u + 2u + 4u, first.next);
    const Scan second = scan("A", text, first.next);
    EXPECT_TRUE(second.found);
    EXPECT_EQ("2", second.value);
}

TEST(HttpClientElementScanner, NextIsLoweredToTheLastIndex) {
    const Scan s = scan("A", "<A>x</A>");
    EXPECT_EQ(7u, s.next);  // 8 would lie beyond the text
    EXPECT_FALSE(scan("A", "<A>x</A>", s.next).found);
}

TEST(HttpClientElementScanner, MissesElementsWithAttributesOrSelfClosing) {
    EXPECT_FALSE(scan("A", "<A id=\"1\">x</A>").found);
    EXPECT_FALSE(scan("A", "<A/>").found);
    EXPECT_FALSE(scan("A", "<A>never closed").found);
    EXPECT_FALSE(scan("A", "<A>").found);  // value would start beyond the text
    EXPECT_FALSE(scan("A", "<A>x</A>", 1).found);
    EXPECT_FALSE(scan("A", "<A>x</A>", 500).found);
    EXPECT_FALSE(scan("A", "").found);
}

}  // namespace
}  // namespace Configuration
