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

void expectRefused(const std::string& text, const std::string& fragment) {
    const std::string message = refusal(text);
    EXPECT_NE(std::string::npos, message.find(fragment))
        << "input: " << text << "\nmessage: " << message;
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

// Text nested depth levels deep, as alternating e and l nodes.
std::string nestedDocument(int depth) {
    std::string text;
    for (int level = 1; level <= depth; ++level) {
        text += level % 2 == 1 ? "<e k=\"x\">" : "<l>";
    }
    for (int level = depth; level >= 1; --level) {
        text += level % 2 == 1 ? "</e>" : "</l>";
    }
    return text;
}

TEST(XmlHostile, MalformedXmlIsRefused) {
    for (const char* text :
         {"", " \n ", "plain text", "<e k=\"a\">", "<e k=\"a\"></f>", "<e k=\"a\"><s>x</e></s>",
          "<e k=a></e>", "<e k=\"a\"></e></e>", "<e k=\"a\" <s/></e>", "<<e k=\"a\"/>", "</e>"}) {
        EXPECT_FALSE(refusal(text).empty()) << text;
    }
    expectRefused("<e k=\"a\"></f>", "malformed XML at byte");
}

TEST(XmlHostile, UnknownEntityReferencesStayLiteralText) {
    EXPECT_EQ(textElement("a", "&undefined;"), parseText("<e k=\"a\"><s>&undefined;</s></e>"));
}

TEST(XmlHostile, EveryTruncationOfAValidDocumentIsRefused) {
    const std::string text = sampleDocument();
    ASSERT_NO_THROW(parseText(text));
    for (std::size_t len = 0; len < text.size(); ++len) {
        EXPECT_FALSE(refusal(text.substr(0, len)).empty()) << "length " << len;
    }
}

TEST(XmlHostile, UnknownRootOrStructureIsRefused) {
    expectRefused("<config><e k=\"a\"/></config>", "the root element must be <e>, not <config>");
    expectRefused("<e k=\"a\"/><e k=\"b\"/>", "more than one root element");
    expectRefused("<e k=\"a\"/>trailing", "text is not allowed outside the root element");
    expectRefused("<e k=\"a\"/>x", "text is not allowed outside the root element");
    expectRefused("<e/>", "<e> takes exactly one attribute");
    expectRefused("<e k=\"a\" k64=\"YQ==\"/>", "<e> takes exactly one attribute");
    expectRefused("<e key=\"a\"/>", "<e> takes exactly one attribute");
    expectRefused("<e k=\"a\"><x/></e>", "unexpected <x> inside <e>");
    expectRefused("<e k=\"a\"><e k=\"b\"/></e>", "unexpected <e> inside <e>");
    expectRefused("<e k=\"a\">text</e>", "text is not allowed inside <e>");
    expectRefused("<e k=\"a\"><s/>text</e>", "text is not allowed inside <e>");
    expectRefused("<e k=\"a\"><s>1</s><s>2</s></e>", "more than one value inside <e>");
    expectRefused("<e k=\"a\"><s>1</s><a n=\"n\" v=\"v\"/></e>", "<a> after the value");
    expectRefused("<e k=\"a\"><a n=\"n\"/></e>", "<a> takes exactly two attributes");
    expectRefused("<e k=\"a\"><a v=\"v\" n=\"n\"/></e>", "<a> takes exactly two attributes");
    expectRefused("<e k=\"a\"><a n=\"n\" v=\"v\">x</a></e>", "<a> must be empty");
    expectRefused("<e k=\"a\"><s x=\"1\">v</s></e>", "<s> takes no attributes");
    expectRefused("<e k=\"a\"><s>a<b/>c</s></e>", "<s> holds text only");
    expectRefused("<e k=\"a\"><l><s>v</s></l></e>", "unexpected <s> inside <l>");
    expectRefused("<e k=\"a\"><l>x</l></e>", "text is not allowed inside <l>");
    expectRefused("<e k=\"a\"><m><e k=\"b\"/></m></e>", "unexpected <e> inside <m>");
    expectRefused("<e k=\"a\"><m><a n=\"\" v=\"\"/></m></e>", "unexpected <a> inside <m>");
    expectRefused("<e k=\"a\"><m>x</m></e>", "text is not allowed inside <m>");
    expectRefused("<e k=\"" + std::string(500, 'n') + "\"><" + std::string(500, 'x') + "/></e>",
                  "unexpected <xxxxxxxxxxxxxxxxxxxxxxxxxxxxxxxx...> inside <e>");
}

TEST(XmlHostile, DoctypesAreRefusedAndEntitiesNeverExpanded) {
    expectRefused("<!DOCTYPE e><e k=\"a\"/>", "a DOCTYPE is not accepted");
    expectRefused(kDeclaration + "<!DOCTYPE e [<!ENTITY x \"expanded\">]><e k=\"a\"><s>&x;</s></e>",
                  "a DOCTYPE is not accepted");
    std::string laughs = "<!DOCTYPE e [<!ENTITY l0 \"lol\">";
    for (int i = 1; i < 10; ++i) {
        std::string body;
        for (int j = 0; j < 10; ++j) {
            body += "&l" + std::to_string(i - 1) + ";";
        }
        laughs += "<!ENTITY l" + std::to_string(i) + " \"" + body + "\">";
    }
    expectRefused(laughs + "]><e k=\"a\"><s>&l9;</s></e>", "a DOCTYPE is not accepted");
    expectRefused("<!DOCTYPE e SYSTEM \"file:///etc/passwd\"><e k=\"a\"><s>&x;</s></e>",
                  "a DOCTYPE is not accepted");
    EXPECT_FALSE(refusal("<e k=\"a\"><!DOCTYPE e></e>").empty());
}

TEST(XmlHostile, NestingBeyondTheLimitIsRefusedWithoutExhaustingTheStack) {
    EXPECT_NO_THROW(parseText(nestedDocument(XmlUtils::kMaxDepth)));
    expectRefused(nestedDocument(XmlUtils::kMaxDepth + 1), "nests deeper than 200 levels");
    expectRefused(nestedDocument(100000), "nests deeper than 200 levels");
    std::string multis = "<e k=\"a\">";
    for (int i = 0; i < 50000; ++i) {
        multis += "<m>";
    }
    for (int i = 0; i < 50000; ++i) {
        multis += "</m>";
    }
    expectRefused(multis + "</e>", "nests deeper than 200 levels");
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

TEST(XmlHostile, BytesAndCharactersOutsideTheModelAreRefused) {
    expectRefused(std::string("<e k=\"a\"><s>x\0y</s></e>", 22), "NUL byte");
    expectRefused("<e k=\"a\"><s>&#x100;</s></e>", "above U+00FF");
    expectRefused("<e k=\"a\"><s>\xE2\x82\xAC</s></e>", "above U+00FF");  // UTF-8 euro sign
    expectRefused("<e k=\"\xC3\"><s/></e>", "broken UTF-8");              // undeclared 8-bit
    expectRefused("<e k=\"a\"><s64>not base64!</s64></e>", "not valid Base64");
    expectRefused("<e k64=\"YQ\"/>", "not valid Base64");
    // Declared ISO-8859-1, the same bytes are characters of their own.
    EXPECT_EQ(textElement("\xC3", "\xE2\x82\xAC"),
              parseText(kDeclaration + "<e k=\"\xC3\"><s>\xE2\x82\xAC</s></e>"));
}

TEST(XmlHostile, RandomCorruptionsEitherReadConsistentlyOrAreRefused) {
    const std::string valid = sampleDocument();
    const std::string alphabet = "<>/=\"'&;#x e k s64mla!-[]\x01\xE9\xFF";
    std::mt19937 random(20240611u);
    for (int round = 0; round < 2000; ++round) {
        std::string text = valid;
        const int edits = 1 + static_cast<int>(random() % 4);
        for (int i = 0; i < edits; ++i) {
            const std::size_t at = random() % text.size();
            switch (random() % 3) {
                case 0:
                    text[at] = alphabet[random() % alphabet.size()];
                    break;
                case 1:
                    text.erase(at, 1 + random() % 8);
                    break;
                default:
                    text.insert(at, 1, alphabet[random() % alphabet.size()]);
                    break;
            }
            if (text.empty()) {
                text = "<";
            }
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
