// XmlDirectReader: builds an element tree straight from XML text in the exact shape that
// XmlTreeWriter prints (declaration, <e>, <a>, <s>, <s64>, <m>, <l>, the entities the writer uses),
// in one pass and without a DOM. It reads only that shape: at anything else (comments, other
// quoting or spacing, unknown entities, control bytes, nesting past the limit, malformed
// Base64...) it gives up and returns false, and the caller parses the text with the general
// reader, which accepts or refuses it with its own messages. What it does accept, it reads into
// the same tree as the general reader. One reader per document; not thread-safe.
#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "Quorvex/auto_ptr.h"
#include "Vesk/Element.h"

namespace Vesk {

class XmlDirectReader {
public:
    // Reads the len bytes at text into out and returns true; false (out unspecified) when the
    // text is not in the writer's shape.
    static bool read(const char* text, std::size_t len, Element& out);

private:
    XmlDirectReader(const char* text, std::size_t len) : m_at(text), m_end(text + len) {}

    bool document(Element& out);
    // An <e> node from its "<e" on; the element is made by make(key) and then filled.
    template <class Make>
    bool element(int depth, Make make);
    bool content(int depth, Element& element);
    bool attribute(Attributes& attributes);
    // A value node (s, s64, m or l) given to target (an Element or a MultiValue).
    template <class Target>
    bool value(int depth, Target& target);
    bool multi(int depth, MultiValue& multi);
    bool list(int depth, MultiElementValue& list);
    // The text up to stop (exclusive), entities replaced, as a view valid until the next call.
    bool text(char stop, bool inAttribute, std::string_view& out);
    // ` name="..."` or ` name64="..."`, decoded.
    bool namedText(char name, std::string_view& out);
    bool base64(std::string_view encoded, std::string_view& out);
    bool entity(std::string& out);

    // Consumes literal when the text continues with it (inline: called for every tag).
    bool eat(std::string_view literal) {
        if (static_cast<std::size_t>(m_end - m_at) < literal.size()) {
            return false;
        }
        for (std::size_t i = 0; i < literal.size(); ++i) {
            if (m_at[i] != literal[i]) {
                return false;
            }
        }
        m_at += literal.size();
        return true;
    }
    void skipBlanks() {
        while (m_at != m_end && (*m_at == ' ' || *m_at == '\n' || *m_at == '\t')) {
            ++m_at;
        }
    }

    const char* m_at;
    const char* const m_end;
    std::string m_scratch;                            // a text whose entities were replaced
    Quorvex::ByteArray m_decoded;                     // bytes decoded from Base64
    std::vector<std::unique_ptr<Element>> m_pending;  // children read, not yet in their list
};

}  // namespace Vesk
