#include "Vesk/XmlUtils.h"

#include <string>
#include <utility>

#include "Quorvex/StreamException.h"
#include "XmlDirectReader.h"
#include "XmlTreeReader.h"
#include "XmlTreeWriter.h"

namespace Vesk {
namespace XmlUtils {

namespace {

void checkSize(std::size_t len) {
    if (len > kMaxTextBytes) {
        throw TrelException("Vesk::XmlUtils: the XML text has " + std::to_string(len) +
                            " bytes, more than the limit of " + std::to_string(kMaxTextBytes));
    }
}

void checkRootName(const Element& tree, const ACE_CString& name) {
    if (!name.empty() && !(tree.key() == name)) {
        throw TrelException("Vesk::XmlUtils: the root element is '" +
                            std::string(tree.key().c_str(), tree.key().length()) + "', expected '" +
                            std::string(name.c_str(), name.length()) + "'");
    }
}

// Parses text (which it uses as pugixml's working buffer) into out. Text in the writer's own
// shape is read directly, without a DOM; pugixml reads (or refuses) everything else.
void parseInPlace(std::string& text, Element& out, const ACE_CString& name) {
    checkSize(text.size());
    {
        Element direct;
        if (XmlDirectReader::read(text.data(), text.size(), direct)) {
            checkRootName(direct, name);
            out = std::move(direct);
            return;
        }
    }
    Element tree = XmlTreeReader::parse(text);
    checkRootName(tree, name);
    out = std::move(tree);
}

}  // namespace

void streamIn(InputStream& in, Element& out, const ACE_CString& name) {
    std::string text;
    try {
        text = in.readAll(kMaxTextBytes);
    } catch (const Quorvex::StreamException& e) {
        throw TrelException(std::string("Vesk::XmlUtils::streamIn: cannot read the XML text: ") +
                            e.what());
    }
    parseInPlace(text, out, name);
}

void parse(const char* text, std::size_t len, Element& out, const ACE_CString& name) {
    checkSize(len);
    std::string copy(text, len);
    parseInPlace(copy, out, name);
}

void streamOut(const Element& element, OutputStream& out, const Ordering& ordering,
               const ACE_CString& name) {
    std::string text;
    XmlTreeWriter(text, ordering.layout()).writeDocument(element, name.empty() ? nullptr : &name);
    out.write(text);
}

std::string toString(const Element& element, const Ordering& ordering) {
    std::string text;
    XmlTreeWriter(text, ordering.layout()).writeDocument(element, nullptr);
    return text;
}

}  // namespace XmlUtils
}  // namespace Vesk
