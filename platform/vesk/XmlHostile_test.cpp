// Hostile and broken XML: every input ends in Vesk::TrelException with a message, never a crash,
// a hang or another exception type.
#include <gtest/gtest.h>

#include <random>
#include <string>

#include "Quorvex/InputMemStream.h"
#include "Vesk/XmlUtils.h"
#include "XmlTestSupport.h"

namespace Vesk {
namespace {

using Testing::parseText;
using Testing::textElement;

const std::string kDeclaration = "<?xml version=\"1.0\" encoding=\"ISO-8859-1\"?>";

// The message of the TrelException that reading text gives ("" if it is read).
std::string refusal(const std::string& text) {
    try {
        parseText(text);
    } catch (const TrelException& e) {
        return e.what();
    }
    return "";
}

// A valid document with one of every kind of node.
std::string sampleDocument() {
    Element root("Root");
    root.insertAttributes({{"n", "v"}});
    MultiElementValue& children = root.addMultiElement();
    children.addElement(textElement("Tag", "a<b"));
    children.addElement(textElement("Bin", "\x01"));
    MultiValue& values = children.addElement(new Element("List")).addMulti();
    values.addSingle().assign("x");
    values.addMultiElement();
    return XmlUtils::toString(root);
}

std::string repeated(const std::string& part, int times) {
    std::string text;
    for (int i = 0; i < times; ++i) {
        text += part;
    }
    return text;
}

// Text nested depth levels deep, as alternating e and l nodes.
std::string nestedDocument(int depth) {
    const std::string inner = depth % 2 == 1 ? "<e k=\"x\"></e>" : "";
    return repeated("<e k=\"x\"><l>", depth / 2) + inner + repeated("</l></e>", depth / 2);
}

TEST(XmlHostile, HostileInputIsRefusedWithItsReason) {
    const std::string e = "<e k=\"a\">";
    const struct {
        std::string text;
        const char* reason;
    } cases[] = {
        {e + "</f>", "malformed XML at byte"},
        {"<config><e k=\"a\"/></config>", "the root element must be <e>, not <config>"},
        {"<e k=\"a\"/><e k=\"b\"/>", "more than one root element"},
        {"<e k=\"a\"/>trailing", "text is not allowed outside the root element"},
        {"<e/>", "<e> takes exactly one attribute"},
        {"<e k=\"a\" k64=\"YQ==\"/>", "<e> takes exactly one attribute"},
        {"<e key=\"a\"/>", "<e> takes exactly one attribute"},
        {e + "<x/></e>", "unexpected <x> inside <e>"},
        {e + "<e k=\"b\"/></e>", "unexpected <e> inside <e>"},
        {e + "text</e>", "text is not allowed inside <e>"},
        {e + "<s/>text</e>", "text is not allowed inside <e>"},
        {e + "<s>1</s><s>2</s></e>", "more than one value inside <e>"},
        {e + "<s>1</s><a n=\"n\" v=\"v\"/></e>", "<a> after the value"},
        {e + "<a n=\"n\"/></e>", "<a> takes exactly two attributes"},
        {e + "<a v=\"v\" n=\"n\"/></e>", "<a> takes exactly two attributes"},
        {e + "<a n=\"n\" v=\"v\">x</a></e>", "<a> must be empty"},
        {e + "<s x=\"1\">v</s></e>", "<s> takes no attributes"},
        {e + "<s>a<b/>c</s></e>", "<s> holds text only"},
        {e + "<l><s>v</s></l></e>", "unexpected <s> inside <l>"},
        {e + "<l>x</l></e>", "text is not allowed inside <l>"},
        {e + "<m><e k=\"b\"/></m></e>", "unexpected <e> inside <m>"},
        {e + "<m><a n=\"\" v=\"\"/></m></e>", "unexpected <a> inside <m>"},
        {e + "<m>x</m></e>", "text is not allowed inside <m>"},
        {"<e k=\"" + std::string(500, 'n') + "\"><" + std::string(500, 'x') + "/></e>",
         "unexpected <xxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxx...> inside <e>"},
        // Entities are never expanded: any DOCTYPE is refused before one could be defined.
        {"<!DOCTYPE e><e k=\"a\"/>", "a DOCTYPE is not accepted"},
        {kDeclaration + "<!DOCTYPE e [<!ENTITY x \"expanded\">]>" + e + "<s>&x;</s></e>",
         "a DOCTYPE is not accepted"},
        {"<!DOCTYPE e SYSTEM \"file:///etc/passwd\">" + e + "<s>&x;</s></e>",
         "a DOCTYPE is not accepted"},
        // Nesting is bounded without exhausting the stack.
        {nestedDocument(XmlUtils::kMaxDepth + 1), "nests deeper than 200 levels"},
        {nestedDocument(100000), "nests deeper than 200 levels"},
        {e + repeated("<m>", 50000) + repeated("</m>", 50000) + "</e>",
         "nests deeper than 200 levels"},
        {std::string("<e k=\"a\"><s>x\0y</s></e>", 22), "NUL byte"},
        {e + "<s>&#x100;</s></e>", "above U+00FF"},
        {e + "<s>\xE2\x82\xAC</s></e>", "above U+00FF"},  // UTF-8 euro sign
        {"<e k=\"\xC3\"><s/></e>", "broken UTF-8"},       // undeclared 8-bit
        {e + "<s64>not base64!</s64></e>", "not valid Base64"},
        {"<e k64=\"YQ\"/>", "not valid Base64"},
    };
    for (const std::string& text :
         {std::string(), std::string(" \n "), std::string("plain text"), e, e + "<s>x</e></s>",
          std::string("<e k=a></e>"), e + "</e></e>", std::string("<e k=\"a\" <s/></e>"),
          std::string("<<e k=\"a\"/>"), std::string("</e>"), e + "<!DOCTYPE e></e>"}) {
        EXPECT_FALSE(refusal(text).empty()) << text;
    }
    for (const auto& c : cases) {
        const std::string message = refusal(c.text);
        EXPECT_NE(std::string::npos, message.find(c.reason))
            << "input: " << c.text.substr(0, 200) << "\nmessage: " << message;
    }
}

TEST(XmlHostile, EveryTruncationOfAValidDocumentIsRefused) {
    const std::string text = sampleDocument();
    ASSERT_NO_THROW(parseText(text));
    for (std::size_t len = 0; len < text.size(); ++len) {
        EXPECT_FALSE(refusal(text.substr(0, len)).empty()) << "length " << len;
    }
}

TEST(XmlHostile, NearMissesAreRead) {
    EXPECT_NO_THROW(parseText(nestedDocument(XmlUtils::kMaxDepth)));
    EXPECT_EQ(textElement("a", "&undefined;"), parseText("<e k=\"a\"><s>&undefined;</s></e>"));
    // Declared ISO-8859-1, bytes that are broken UTF-8 are characters of their own.
    EXPECT_EQ(textElement("\xC3", "\xE2\x82\xAC"),
              parseText(kDeclaration + "<e k=\"\xC3\"><s>\xE2\x82\xAC</s></e>"));
}

TEST(XmlHostile, TextsLargerThanTheLimitAreRefusedBeforeReading) {
    const char small[] = "<e k=\"a\"/>";
    Element out;
    // The length alone is refused: nothing past the real bytes is ever read.
    EXPECT_THROW(XmlUtils::parse(small, XmlUtils::kMaxTextBytes + 1, out), TrelException);
    InputMemStream in(small, XmlUtils::kMaxTextBytes + 1);
    try {
        XmlUtils::streamIn(in, out);
        FAIL();
    } catch (const TrelException& e) {
        EXPECT_NE(std::string::npos, std::string(e.what()).find("cannot read the XML text"));
    }
}

TEST(XmlHostile, RandomCorruptionsEitherReadConsistentlyOrAreRefused) {
    const std::string valid = sampleDocument();
    const std::string alphabet = "<>/=\"'&;#x e k s64mla!-[]\x01\xE9\xFF";
    std::mt19937 random(20240611u);
    for (int round = 0; round < 2000; ++round) {
        std::string text = valid;
        for (unsigned edits = 1 + random() % 4; edits > 0; --edits) {
            // Replaces 0..3 bytes by 0..2 bytes: an insertion, deletion or change.
            const std::size_t at = random() % (text.size() + 1);
            const std::size_t removed = random() % 4;
            const std::size_t added = random() % 3;
            text.replace(at, removed, std::string(added, alphabet[random() % alphabet.size()]));
        }
        try {
            const Element tree = parseText(text);
            EXPECT_EQ(tree, Testing::reparse(tree)) << text;
        } catch (const TrelException&) {
        }
    }
}

}  // namespace
}  // namespace Vesk
