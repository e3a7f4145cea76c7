// XmlEmitter: escaping of texts and attribute values, explicit closing tags, and that what it
// writes reads back through a real XML parser as the texts it was given.
#include <gtest/gtest.h>

#include <pugixml.hpp>

#include <string>

#include "Quorvex/OutputMemStream.h"
#include "Vesk/XmlEmitter.h"

namespace Vesk {
namespace {

TEST(XmlEmitter, EscapesMarkupAndQuotesAndNeverSelfCloses) {
    OutputMemStream out;
    XmlEmitter emitter(out);
    XmlAttributes attributes;
    attributes.add("xmlns", "urn:a?b=\"c\"&d='e'<f>");
    emitter.startElement("Message", attributes);
    emitter.textElement("Name", "<Tom & \"Jerry's\">");
    emitter.textElement("Empty", "");
    emitter.startElement("Open");
    emitter.endElement();
    emitter.endElement();
    EXPECT_EQ(
        "<Message xmlns=\"urn:a?b=&quot;c&quot;&amp;d=&apos;e&apos;&lt;f&gt;\">"
        "<Name>&lt;Tom &amp; &quot;Jerry&apos;s&quot;&gt;</Name><Empty></Empty><Open></Open>"
        "</Message>",
        out.str());
}

TEST(XmlEmitter, WhitespaceSurvivesAStandardParser) {
    OutputMemStream out;
    XmlEmitter emitter(out);
    XmlAttributes attributes;
    attributes.add("a", "tab\tline\ncr\r");
    emitter.startElement("E", attributes);
    emitter.characters("cr\r\nlf\n\xE9");
    emitter.endElement();
    pugi::xml_document doc;
    ASSERT_TRUE(
        doc.load_buffer(out.data(), out.size(), pugi::parse_default, pugi::encoding_latin1));
    EXPECT_STREQ("tab\tline\ncr\r", doc.child("E").attribute("a").value());
    EXPECT_STREQ("cr\r\nlf\n\xC3\xA9", doc.child("E").child_value());
}

TEST(XmlEmitter, ClosingTooOftenOrUnwritableControlCharactersThrow) {
    OutputMemStream out;
    XmlEmitter emitter(out);
    emitter.startElement("A");
    EXPECT_THROW(emitter.characters("bell\x07"), TrelException);
    XmlAttributes attributes;
    attributes.add("a", "\x1B");
    EXPECT_THROW(emitter.startElement("B", attributes), TrelException);
    EXPECT_EQ("<A>", out.str());  // nothing half-written
    emitter.endElement();
    EXPECT_THROW(emitter.endElement(), TrelException);
}

}  // namespace
}  // namespace Vesk
