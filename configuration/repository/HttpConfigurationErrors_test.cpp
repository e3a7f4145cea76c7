// The exception family, the error record and the element scanner of HttpConfigurationClient.
#include <gtest/gtest.h>

#include <string>

#include "Configuration/ErrorData.h"
#include "Configuration/HttpConfigurationClient.h"
#include "Configuration/HttpConfigurationException.h"
#include "Configuration/HttpConfigurationFolderLimitReachedException.h"
#include "Configuration/HttpConfigurationInvalidNodeIdException.h"
#include "Configuration/HttpConfigurationItemLimitReachedException.h"
#include "Configuration/HttpConfigurationPathNotFoundException.h"
#include "Configuration/HttpConfigurationTransportException.h"

namespace Configuration {
namespace {

std::string whatOf(const std::exception& e) {
    return e.what();
}

TEST(HttpConfigurationException, WhatIsThePrefixAndTheMessage) {
    EXPECT_EQ("HttpConfigurationException: ", whatOf(HttpConfigurationException("")));
    EXPECT_EQ("HttpConfigurationException: boom", whatOf(HttpConfigurationException("boom")));
}

TEST(HttpConfigurationException, WhatAddsKeyCodeAndTraceButNeverTheLocalizedMessage) {
    const HttpConfigurationException all("K", "C", "M", "T", "L");
    EXPECT_EQ("HttpConfigurationException: M ErrorKey: K ErrorCode: C OriginalStackTrace: T",
              whatOf(all));
    EXPECT_EQ("K", std::string(all.Key().c_str()));
    EXPECT_EQ("C", std::string(all.Code().c_str()));
    EXPECT_EQ("M", std::string(all.Message().c_str()));
    EXPECT_EQ("T", std::string(all.OriginalStackTrace().c_str()));
    EXPECT_EQ("L", std::string(all.LocalizedMessage().c_str()));
}

TEST(HttpConfigurationException, EachConstructorFillsItsFields) {
    EXPECT_EQ("HttpConfigurationException: M ErrorKey: K",
              whatOf(HttpConfigurationException("K", "M")));
    const HttpConfigurationException fourFields("K", "M", "T", "L");
    EXPECT_EQ("HttpConfigurationException: M ErrorKey: K OriginalStackTrace: T",
              whatOf(fourFields));
    EXPECT_TRUE(fourFields.Code().empty());
    EXPECT_EQ("L", std::string(fourFields.LocalizedMessage().c_str()));
    EXPECT_EQ("HttpConfigurationException: M ErrorCode: C",
              whatOf(HttpConfigurationException("", "C", "M", "", "")));
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

template <class Derived>
void expectCaughtAsBase(const char* message) {
    try {
        throw Derived(message);
    } catch (const HttpConfigurationException& e) {
        EXPECT_NE(nullptr, dynamic_cast<const Derived*>(&e));
        EXPECT_EQ(std::string("HttpConfigurationException: ") + message, e.what());
        EXPECT_TRUE(e.Key().empty());
        EXPECT_TRUE(e.Code().empty());
    }
}

TEST(HttpConfigurationException, DerivedClassesCarryOnlyTheMessage) {
    expectCaughtAsBase<HttpConfigurationTransportException>("t");
    expectCaughtAsBase<HttpConfigurationPathNotFoundException>("p");
    expectCaughtAsBase<HttpConfigurationInvalidNodeIdException>("n");
    expectCaughtAsBase<HttpConfigurationFolderLimitReachedException>("f");
    expectCaughtAsBase<HttpConfigurationItemLimitReachedException>("i");
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

TEST(HttpClientElementScanner, CutsTheTextBetweenTheMarks) {
    const Scan s = scan("A", "<x><A>hello</A></x>");
    EXPECT_TRUE(s.found);
    EXPECT_EQ("hello", s.value);
    EXPECT_EQ(15u, s.next);  // just behind "</A>"
}

TEST(HttpClientElementScanner, ReplacesEntities) {
    EXPECT_EQ("a&b<c>", scan("A", "<A>a&amp;b&lt;c&gt;</A>").value);
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

TEST(HttpClientElementScanner, ReadsAnEmptyElementAndStopsAtTheFirstClosingMark) {
    EXPECT_EQ("", scan("A", "<A></A>").value);
    EXPECT_TRUE(scan("A", "<A></A>").found);
    EXPECT_EQ("<A>inner", scan("A", "<A><A>inner</A></A>").value);
}

TEST(HttpClientElementScanner, RepeatedScanCollectsInOrder) {
    const std::string text = "<L><H>a</H><H>b</H><X/><H>c</H></L>";
    std::vector<std::string> found;
    ACE_CString value;
    ACE_CString::size_type next = 0;
    const ACE_CString aceText(text.c_str());
    while (HttpConfigurationClient::findElementText("H", aceText, next, value, next)) {
        found.push_back(value.c_str());
    }
    EXPECT_EQ((std::vector<std::string>{"a", "b", "c"}), found);
}

}  // namespace
}  // namespace Configuration
