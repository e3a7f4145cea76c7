// The XML form of element trees: exact round trips of hand-written trees of every shape, the
// layouts, the streams, and documents written by hand.
#include <gtest/gtest.h>

#include <string>

#include "Quorvex/InputMemStream.h"
#include "Quorvex/OutputMemStream.h"
#include "Vesk/XmlUtils.h"
#include "XmlTestSupport.h"

namespace Vesk {
namespace {

using Testing::parseText;
using Testing::reparse;
using Testing::textElement;

const char kDeclaration[] = "<?xml version=\"1.0\" encoding=\"ISO-8859-1\"?>";

// Round trips tree in both layouts and through the streams.
void expectRoundTrip(const Element& tree) {
    EXPECT_EQ(tree, reparse(tree));
    EXPECT_EQ(tree, reparse(tree, Ordering::indented()));
    OutputMemStream out;
    XmlUtils::streamOut(tree, out);
    InputMemStream in(out.data(), out.size());
    Element back("previous");
    back.addSingle().assign("contents");
    XmlUtils::streamIn(in, back);
    EXPECT_EQ(tree, back);
}

// Root "Root" holding one child "Child" with the given text.
Element oneText(const ACE_CString& text) {
    Element root("Root");
    root.addMultiElement().addElement(textElement("Child", text));
    return root;
}

// A chain of e and l nodes nesting exactly depth levels (the root e is level 1).
Element chain(int depth) {
    Element root("level");
    Element* current = &root;
    for (int level = 2; level <= depth; level += 2) {
        MultiElementValue& list = current->addMultiElement();
        if (level < depth) {
            current = &list.addElement(new Element("level"));
        }
    }
    return root;
}

TEST(XmlRoundTrip, ElementsWithoutValueAndWithEmptyTextStayApart) {
    Element root("Root");
    MultiElementValue& children = root.addMultiElement();
    children.addElement(new Element("NoValue"));
    children.addElement(textElement("EmptyText", ""));
    const Element back = reparse(root);
    EXPECT_FALSE(back.getMultiElement().getElement("NoValue").hasValue());
    EXPECT_TRUE(back.getMultiElement().getElement("EmptyText").hasValue());
    expectRoundTrip(root);
    expectRoundTrip(Element(""));
    expectRoundTrip(textElement("", ""));
}

TEST(XmlRoundTrip, TextsWithMarkupQuotesAndWhitespace) {
    for (const char* text : {"<&>\"'", "]]>", "&amp;", "&#13;", " ", "   ", "\t", "\n", "\r",
                             "\r\n", " \r\n\t ", "  leading", "trailing  ", "a\rb\nc\r\nd",
                             "<s>not a node</s>", "<![CDATA[x]]>", "<!-- c -->"}) {
        SCOPED_TRACE(text);
        expectRoundTrip(oneText(text));
    }
}

TEST(XmlRoundTrip, KeysAndAttributesWithEveryKindOfCharacter) {
    Element root("key <&>\"' \t\r\n\xE9\x01");
    root.insertAttributes({{"", ""},
                           {"name <&>\"'", "value \t\r\n  end"},
                           {"dup", "1"},
                           {"dup", "2"},
                           {"\x1F", "\xFF\x80"},
                           {"   ", "\x7F"}});
    root.addMultiElement().addElement(new Element("child")).insertAttributes({{"x", "y"}});
    expectRoundTrip(root);
}

TEST(XmlRoundTrip, EightBitBytesAreWrittenAsSingleRawBytes) {
    const Element tree = oneText("caf\xE9 \xA0\xFF\x80\x9F");
    const std::string text = XmlUtils::toString(tree);
    EXPECT_NE(std::string::npos, text.find("<s>caf\xE9 \xA0\xFF\x80\x9F</s>"));
    expectRoundTrip(tree);
}

TEST(XmlRoundTrip, ControlCharactersAreWrittenInBase64) {
    const Element tree = oneText("bell\x07 and tab\t");
    const std::string text = XmlUtils::toString(tree);
    EXPECT_NE(std::string::npos, text.find("<s64>YmVsbAcgYW5kIHRhYgk=</s64>"));
    expectRoundTrip(tree);
    // NUL is outside the model, but a string holding one still survives.
    expectRoundTrip(oneText(ACE_CString("a\0b", 3)));
}

TEST(XmlRoundTrip, CarriageReturnIsACharacterReference) {
    const std::string text = XmlUtils::toString(oneText("a\r\nb"));
    EXPECT_NE(std::string::npos, text.find("<s>a&#13;\nb</s>"));
}

TEST(XmlRoundTrip, MultiValuesHoldEveryKindAndNestedLists) {
    Element root("Root");
    MultiValue& values = root.addMulti();
    values.addSingle().assign("first");
    values.addSingle();
    values.addMulti();
    MultiValue& nested = values.addMulti();
    nested.addMulti().addMulti().addSingle().assign("deep");
    nested.addMultiElement();
    MultiElementValue& elements = values.addMultiElement();
    elements.addElement(textElement("A", "1"));
    elements.addElement(new Element("B")).addMulti().addSingle().assign(" ");
    expectRoundTrip(root);
}

TEST(XmlRoundTrip, ListsKeepOrderAndRepeatedKeys) {
    Element root("Root");
    MultiElementValue& children = root.addMultiElement();
    for (const char* key : {"B", "A", "B", "C", "A"}) {
        children.addElement(textElement(key, key));
    }
    children.addElement(new Element("Empty")).addMultiElement();
    children.addElement(new Element("EmptyMulti")).addMulti();
    expectRoundTrip(root);
    const Element back = reparse(root);
    std::string keys;
    for (const Element& child : back.getMultiElement()) {
        keys += child.key().c_str();
    }
    EXPECT_EQ("BABCAEmptyEmptyMulti", keys);
}

TEST(XmlRoundTrip, NestingUpToTheLimitIsWrittenAndReadBeyondItRefused) {
    expectRoundTrip(chain(XmlUtils::kMaxDepth - 1));
    expectRoundTrip(chain(XmlUtils::kMaxDepth));
    EXPECT_THROW(XmlUtils::toString(chain(XmlUtils::kMaxDepth + 1)), TrelException);
    EXPECT_THROW(XmlUtils::toString(chain(XmlUtils::kMaxDepth + 2)), TrelException);
}

TEST(XmlLayout, CompactFormHasNoWhitespaceBetweenNodes) {
    Element root("Root");
    root.insertAttributes({{"v", "1"}});
    root.addMultiElement().addElement(textElement("Tag", "x y"));
    EXPECT_EQ(std::string(kDeclaration) +
                  "<e k=\"Root\"><a n=\"v\" v=\"1\"/><l><e k=\"Tag\"><s>x y</s></e></l></e>",
              XmlUtils::toString(root));
}

TEST(XmlLayout, IndentedFormPutsEveryNodeOnItsOwnLine) {
    Element root("Root");
    root.insertAttributes({{"v", "1"}});
    MultiElementValue& children = root.addMultiElement();
    children.addElement(textElement("Tag", " x "));
    children.addElement(new Element("None"));
    MultiValue& values = children.addElement(new Element("Values")).addMulti();
    values.addSingle().assign("1");
    values.addMulti();
    EXPECT_EQ(std::string(kDeclaration) +
                  "\n"
                  "<e k=\"Root\">\n"
                  "  <a n=\"v\" v=\"1\"/>\n"
                  "  <l>\n"
                  "    <e k=\"Tag\"><s> x </s></e>\n"
                  "    <e k=\"None\"></e>\n"
                  "    <e k=\"Values\">\n"
                  "      <m>\n"
                  "        <s>1</s>\n"
                  "        <m></m>\n"
                  "      </m>\n"
                  "    </e>\n"
                  "  </l>\n"
                  "</e>\n",
              XmlUtils::toString(root, Ordering::indented()));
}

TEST(XmlStreams, NameReplacesTheRootKeyOnWritingAndIsCheckedOnReading) {
    OutputMemStream out;
    XmlUtils::streamOut(textElement("Old", "v"), out, Ordering(), "New");
    InputMemStream in(out.data(), out.size());
    Element back;
    XmlUtils::streamIn(in, back, "New");
    EXPECT_EQ(textElement("New", "v"), back);

    InputMemStream again(out.data(), out.size());
    Element kept = textElement("Kept", "k");
    EXPECT_THROW(XmlUtils::streamIn(again, kept, "Other"), TrelException);
    EXPECT_EQ(textElement("Kept", "k"), kept);  // a failed read leaves the target alone
}

TEST(XmlStreams, HandWrittenDocumentsWithCommentsCdataAndBlanksAreRead) {
    const std::string text =
        "<?xml version=\"1.0\" encoding=\"ISO-8859-1\"?>\n"
        "<!-- written by hand -->\n"
        "<e k='Root'>\n"
        "  <l>\n"
        "    <e k=\"Split\"><s>a<!-- c -->b<![CDATA[<c>]]>d</s></e>\n"
        "    <e k=\"Latin\"><s>&#233;\xE9</s></e>\n"
        "    <e k=\"Blank\">   <s>  </s>   </e>\n"
        "    <e k=\"Empty\"><s/></e>\n"
        "    <e k=\"None\"/>\n"
        "  </l>\n"
        "</e>\n";
    Element expected("Root");
    MultiElementValue& children = expected.addMultiElement();
    children.addElement(textElement("Split", "ab<c>d"));
    children.addElement(textElement("Latin", "\xE9\xE9"));
    children.addElement(textElement("Blank", "  "));
    children.addElement(textElement("Empty", ""));
    children.addElement(new Element("None"));
    EXPECT_EQ(expected, parseText(text));
}

TEST(XmlStreams, PlainAsciiWithoutDeclarationIsRead) {
    EXPECT_EQ(textElement("K", "v"), parseText("<e k=\"K\"><s>v</s></e>"));
}

}  // namespace
}  // namespace Vesk
