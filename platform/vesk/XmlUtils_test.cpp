// The XML form of element trees: its exact output, exact round trips of the shapes random trees
// rarely produce, the streams, and documents written by hand.
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

// Round trips tree in both layouts and through the streams (replacing an earlier tree).
void expectRoundTrip(const Element& tree) {
    EXPECT_EQ(tree, reparse(tree));
    EXPECT_EQ(tree, reparse(tree, Ordering::indented()));
    OutputMemStream out;
    XmlUtils::streamOut(tree, out);
    InputMemStream in(out.data(), out.size());
    Element back = textElement("previous", "contents");
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

TEST(XmlRoundTrip, ShapesRandomTreesRarelyProduce) {
    Element root("Root");
    MultiElementValue& children = root.addMultiElement();
    children.addElement(new Element("NoValue"));  // stays apart from an empty text
    children.addElement(textElement("EmptyText", ""));
    for (const char* key : {"B", "A", "B", "A"}) {
        children.addElement(textElement(key, key));
    }
    children.addElement(new Element("Empty")).addMultiElement();
    children.addElement(new Element("EmptyMulti")).addMulti();
    expectRoundTrip(root);
    expectRoundTrip(Element(""));
    expectRoundTrip(textElement("", ""));
    expectRoundTrip(oneText(ACE_CString("a\0b", 3)));  // NUL is outside the model yet survives
    for (const char* text : {"]]>", "&amp;", "&#13;", "<s>not a node</s>", "<![CDATA[x]]>",
                             "<!-- c -->", " \r\n\t ", "a\rb\nc\r\nd", "   "}) {
        SCOPED_TRACE(text);
        Element markup(text);
        markup.insertAttributes({{text, text}, {"dup", "1"}, {"dup", text}});
        markup.addMultiElement().addElement(textElement(text, text));
        expectRoundTrip(markup);
    }
}

TEST(XmlRoundTrip, NestingUpToTheLimitIsWrittenBeyondItRefused) {
    expectRoundTrip(chain(XmlUtils::kMaxDepth - 1));
    expectRoundTrip(chain(XmlUtils::kMaxDepth));
    EXPECT_THROW(XmlUtils::toString(chain(XmlUtils::kMaxDepth + 1)), TrelException);
    EXPECT_THROW(XmlUtils::toString(chain(XmlUtils::kMaxDepth + 2)), TrelException);
}

TEST(XmlLayout, TextsAreWrittenRawEscapedOrInBase64) {
    const struct {
        const char* text;
        const char* written;
    } cases[] = {
        {"caf\xE9 \xA0\xFF\x80\x9F", "<s>caf\xE9 \xA0\xFF\x80\x9F</s>"},  // single raw bytes
        {"a\r\nb<&>", "<s>a&#13;\nb&lt;&amp;&gt;</s>"},
        {"bell\x07 and tab\t", "<s64>YmVsbAcgYW5kIHRhYgk=</s64>"},  // control characters
    };
    for (const auto& c : cases) {
        const std::string text = XmlUtils::toString(oneText(c.text));
        EXPECT_NE(std::string::npos, text.find(c.written)) << text;
        expectRoundTrip(oneText(c.text));
    }
}

TEST(XmlLayout, CompactAndIndentedFormsAreExact) {
    Element root("Root");
    root.insertAttributes({{"v", "1"}});
    MultiElementValue& children = root.addMultiElement();
    children.addElement(textElement("Tag", " x "));
    children.addElement(new Element("None"));
    MultiValue& values = children.addElement(new Element("Values")).addMulti();
    values.addSingle().assign("1");
    values.addMulti();
    EXPECT_EQ(std::string(kDeclaration) +
                  "<e k=\"Root\"><a n=\"v\" v=\"1\"/><l><e k=\"Tag\"><s> x </s></e><e k=\"None\">"
                  "</e><e k=\"Values\"><m><s>1</s><m></m></m></e></l></e>",
              XmlUtils::toString(root));
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
    EXPECT_EQ(textElement("K", "v"), parseText("<e k=\"K\"><s>v</s></e>"));  // no declaration
}

}  // namespace
}  // namespace Vesk
