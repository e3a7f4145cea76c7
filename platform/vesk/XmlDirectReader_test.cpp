// The direct road from XML text to a tree: it takes everything the writer prints, and whatever it
// takes it reads into the very tree that the general (pugixml) reader makes of the same text.
#include <gtest/gtest.h>

#include <pugixml.hpp>

#include <string>
#include <vector>

#include "Vesk/XmlUtils.h"
#include "XmlDirectReader.h"
#include "XmlTestSupport.h"
#include "XmlTreeReader.h"

namespace Vesk {
namespace {

using Testing::textElement;

const std::string kDeclaration = "<?xml version=\"1.0\" encoding=\"ISO-8859-1\"?>";

// The tree the general reader makes of text, as XmlUtils configures it; false when it refuses.
bool readGenerally(std::string text, Element& out) {
    pugi::xml_document doc;
    const unsigned options = pugi::parse_default | pugi::parse_ws_pcdata |
                             pugi::parse_embed_pcdata | pugi::parse_doctype | pugi::parse_fragment;
    if (!doc.load_buffer_inplace(&text[0], text.size() + 1, options)) {
        return false;
    }
    try {
        out = XmlTreeReader::read(doc);
        return true;
    } catch (const TrelException&) {
        return false;
    }
}

// A tree with every kind of node and the bytes that need care.
Element richTree() {
    Element root("Root \"&<>' \xe9");
    root.insertAttributes({{"name", "a\tb\nc\rd"}, {"\x01", "bytes \xff"}});
    MultiElementValue& children = root.addMultiElement();
    children.addElement(new Element("NoValue"));
    children.addElement(textElement("Empty", ""));
    children.addElement(textElement("Blanks", " \t\n "));
    children.addElement(textElement("Control", "a\x01\r\x1f"));
    children.addElement(textElement("Latin1", "caf\xe9 \xa0\xff ]]>"));
    MultiValue& multi = children.addElement(new Element("Multi")).addMulti();
    multi.addSingle().assign("one");
    multi.addMulti().addSingle().assign("nested");
    multi.addMultiElement().addElement(textElement("InMulti", "x"));
    children.addElement(new Element("EmptyList")).addMultiElement();
    return root;
}

TEST(XmlDirectReader, TakesWhatTheWriterPrintsInBothLayouts) {
    const Element tree = richTree();
    for (const Ordering& ordering : {Ordering(), Ordering::indented()}) {
        const std::string text = XmlUtils::toString(tree, ordering);
        Element direct;
        ASSERT_TRUE(XmlDirectReader::read(text.data(), text.size(), direct)) << text;
        EXPECT_EQ(tree, direct);
    }
}

// Texts in and near the writer's shape: each is either given up on, or read as the general
// reader reads it.
TEST(XmlDirectReader, ReadsWhatItTakesAsTheGeneralReaderDoes) {
    const std::vector<std::string> bodies = {
        "<e k=\"R\"><s>&lt;&gt;&amp;&quot;&apos;&#9;&#10;&#13;&#xE9;&#233;</s></e>",
        "<e k=\"R\"><s>&#256;</s></e>",
        "<e k=\"R\"><s>&#0;</s></e>",
        "<e k=\"R\"><s>&unknown;</s></e>",
        "<e k=\"R\"><s>&amp</s></e>",
        "<e k=\"R\"><s>a\r\nb</s></e>",
        "<e k=\"R\"><s>a<!-- c -->b</s></e>",
        "<e k=\"R\"><s><![CDATA[<x>]]></s></e>",
        "<e k='R'><s>x</s></e>",
        "<e  k=\"R\"><s>x</s></e>",
        "<e k=\"a\tb\"></e>",
        "<e k=\"a&#9;b\"></e>",
        "<e k64=\"QUI=\"><s64>AAE=</s64></e>",
        "<e k64=\"Q!I=\"></e>",
        "<e k64=\"\"><a n64=\"\" v=\"\"/><s64></s64></e>",
        "<e k=\"R\"><a n=\"x\" v=\"y\"/><a n64=\"eA==\" v64=\"\"/><l>\n <e k=\"c\"/></l></e>",
        "<e k=\"R\"><a n=\"x\" v=\"y\"/><l> <e k=\"c\"></e>\n\t</l></e>",
        "<e k=\"R\"><s>x</s><a n=\"x\" v=\"y\"/></e>",
        "<e k=\"R\"><s>x</s><s>y</s></e>",
        "<e k=\"R\"><m><s>1</s><m></m><l></l><s64>eA==</s64></m></e>",
        "<e k=\"R\"><m><e k=\"x\"></e></m></e>",
        "<e k=\"R\"><l><s>x</s></l></e>",
        "<e k=\"R\">text</e>",
        "<e k=\"R\"></e><e k=\"S\"></e>",
        "<e k=\"R\"></e> trailing",
        "<e k=\"R\"><s>x\x01y</s></e>",
        "<e k=\"R\"><s>x</s>",
        "<e k=\"R\"><s>x",
    };
    int taken = 0;
    for (const std::string& body : bodies) {
        for (const std::string& prefix : {kDeclaration, kDeclaration + "\n", std::string()}) {
            const std::string text = prefix + body;
            Element direct;
            if (!XmlDirectReader::read(text.data(), text.size(), direct)) {
                continue;
            }
            ++taken;
            Element general;
            ASSERT_TRUE(readGenerally(text, general)) << text;
            EXPECT_EQ(general, direct) << text;
        }
    }
    EXPECT_GE(taken, 8);  // the table does reach the direct road
}

TEST(XmlDirectReader, GivesUpPastTheNestingLimitSoThatTheLimitIsReported) {
    std::string text = kDeclaration;
    for (int i = 0; i < XmlUtils::kMaxDepth; ++i) {
        text += "<e k=\"x\"><l>";
    }
    for (int i = 0; i < XmlUtils::kMaxDepth; ++i) {
        text += "</l></e>";
    }
    Element tree;
    EXPECT_FALSE(XmlDirectReader::read(text.data(), text.size(), tree));
    try {
        XmlUtils::parse(text.data(), text.size(), tree);
        ADD_FAILURE() << "nesting past the limit was accepted";
    } catch (const TrelException& e) {
        EXPECT_NE(std::string::npos, std::string(e.what()).find("deeper than")) << e.what();
    }
}

}  // namespace
}  // namespace Vesk
