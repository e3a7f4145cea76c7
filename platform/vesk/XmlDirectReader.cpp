#include "XmlDirectReader.h"

#include <array>
#include <stdexcept>
#include <utility>

#include "Quorvex/Base64Coder.h"
#include "Vesk/XmlUtils.h"
#include "XmlFormat.h"

namespace Vesk {

namespace {

// How a byte of a text is read: as it stands, as the end of the text or an entity (both stop
// the plain run), or not at all (the general reader treats it in ways of its own: line-end and
// blank normalisation, control bytes).
enum Class : unsigned char { Plain, Stop, GiveUp };

constexpr std::array<unsigned char, 256> makeClasses(bool inAttribute) {
    std::array<unsigned char, 256> classes{};
    for (int c = 0; c < 0x20; ++c) {
        classes[c] = GiveUp;
    }
    if (!inAttribute) {  // blanks inside attribute values are normalised by the general reader
        classes['\t'] = Plain;
        classes['\n'] = Plain;
    }
    classes['&'] = Stop;
    classes['<'] = inAttribute ? GiveUp : Stop;
    classes['"'] = inAttribute ? Stop : Plain;
    return classes;
}

constexpr std::array<unsigned char, 256> kTextClasses = makeClasses(false);
constexpr std::array<unsigned char, 256> kAttributeClasses = makeClasses(true);

}  // namespace

bool XmlDirectReader::read(const char* text, std::size_t len, Element& out) {
    try {
        return XmlDirectReader(text, len).document(out);
    } catch (const std::invalid_argument&) {  // Base64 that the general reader will refuse
        return false;
    }
}

bool XmlDirectReader::document(Element& out) {
    if (!eat(XmlFormat::kDeclaration)) {  // without it the text would be read as UTF-8
        return false;
    }
    skipBlanks();
    bool made = false;
    const bool ok = element(1, [&](std::string_view key) -> Element& {
        out = Element(key.data(), key.size(), -1);
        made = true;
        return out;
    });
    skipBlanks();
    return ok && made && m_at == m_end;
}

template <class Make>
bool XmlDirectReader::element(int depth, Make make) {
    std::string_view key;
    if (depth > XmlUtils::kMaxDepth || !eat("<e") || !namedText('k', key) || !eat(">")) {
        return false;
    }
    return content(depth, make(key));
}

bool XmlDirectReader::content(int depth, Element& element) {
    Attributes attributes;
    skipBlanks();
    while (eat("<a")) {
        if (!attribute(attributes)) {
            return false;
        }
        skipBlanks();
    }
    if (!attributes.empty()) {
        element.insertAttributes(attributes);
    }
    if (!eat("</e>")) {
        if (!value(depth + 1, element)) {
            return false;
        }
        skipBlanks();
        return eat("</e>");
    }
    return true;
}

bool XmlDirectReader::attribute(Attributes& attributes) {
    std::string_view name;
    if (!namedText('n', name)) {
        return false;
    }
    attributes.emplace_back();
    attributes.back().first.set(name.data(), name.size(), true);
    std::string_view text;
    if (!namedText('v', text) || !eat("/>")) {
        return false;
    }
    attributes.back().second.set(text.data(), text.size(), true);
    return true;
}

template <class Target>
bool XmlDirectReader::value(int depth, Target& target) {
    std::string_view body;
    if (eat("<s>")) {
        if (!text('<', false, body) || !eat("</s>")) {
            return false;
        }
        target.addSingle().assign(body.data(), body.size());
        return true;
    }
    if (eat("<s64>")) {
        std::string_view decoded;
        if (!text('<', false, body) || !eat("</s64>") || !base64(body, decoded)) {
            return false;
        }
        target.addSingle().assign(decoded.data(), decoded.size());
        return true;
    }
    if (depth > XmlUtils::kMaxDepth) {
        return false;
    }
    if (eat("<m>")) {
        return multi(depth, target.addMulti());
    }
    if (eat("<l>")) {
        return list(depth, target.addMultiElement());
    }
    return false;
}

bool XmlDirectReader::multi(int depth, MultiValue& multi) {
    for (skipBlanks(); !eat("</m>"); skipBlanks()) {
        if (!value(depth + 1, multi)) {
            return false;
        }
    }
    return true;
}

bool XmlDirectReader::list(int depth, MultiElementValue& list) {
    // The children wait on m_pending (shared by all levels) until their count is known, so that
    // the list is allocated once at its exact size.
    const std::size_t first = m_pending.size();
    bool ok = true;
    for (skipBlanks(); ok && !eat("</l>"); skipBlanks()) {
        ok = element(depth + 1, [&](std::string_view key) -> Element& {
            std::unique_ptr<Element> child(new Element(key.data(), key.size(), -1));
            m_pending.push_back(std::move(child));
            return *m_pending.back();
        });
    }
    if (ok) {
        list.reserve(m_pending.size() - first);
        for (std::size_t i = first; i < m_pending.size(); ++i) {
            list.addElement(m_pending[i].release());
        }
    }
    m_pending.resize(first);
    return ok;
}

bool XmlDirectReader::namedText(char name, std::string_view& out) {
    if (m_end - m_at < 4 || m_at[0] != ' ' || m_at[1] != name) {
        return false;
    }
    m_at += 2;
    const bool encoded = eat("64");
    if (!eat("=\"") || !text('"', true, out) || !eat("\"")) {
        return false;
    }
    return !encoded || base64(out, out);
}

bool XmlDirectReader::text(char stop, bool inAttribute, std::string_view& out) {
    const std::array<unsigned char, 256>& classes = inAttribute ? kAttributeClasses : kTextClasses;
    const char* start = m_at;
    bool copied = false;
    for (;;) {
        const char* run = m_at;
        while (m_at != m_end && classes[static_cast<unsigned char>(*m_at)] == Plain) {
            ++m_at;
        }
        if (m_at == m_end || classes[static_cast<unsigned char>(*m_at)] == GiveUp) {
            return false;
        }
        if (*m_at == stop) {
            if (!copied) {
                out = std::string_view(start, static_cast<std::size_t>(m_at - start));
                return true;
            }
            m_scratch.append(run, static_cast<std::size_t>(m_at - run));
            out = m_scratch;
            return true;
        }
        if (!copied) {
            m_scratch.assign(start, static_cast<std::size_t>(m_at - start));
            copied = true;
        } else {
            m_scratch.append(run, static_cast<std::size_t>(m_at - run));
        }
        if (*m_at != '&' || !entity(m_scratch)) {
            return false;
        }
    }
}

bool XmlDirectReader::entity(std::string& out) {
    static const struct {
        std::string_view name;
        char byte;
    } kNamed[] = {{"&amp;", '&'}, {"&lt;", '<'}, {"&gt;", '>'}, {"&quot;", '"'}, {"&apos;", '\''}};
    for (const auto& named : kNamed) {
        if (eat(named.name)) {
            out.push_back(named.byte);
            return true;
        }
    }
    if (!eat("&#")) {
        return false;
    }
    const bool hex = eat("x");
    unsigned code = 0;
    int digits = 0;
    for (; m_at != m_end && *m_at != ';' && digits < 4; ++m_at, ++digits) {
        const char c = *m_at;
        const int digit = c >= '0' && c <= '9'          ? c - '0'
                          : hex && c >= 'a' && c <= 'f' ? c - 'a' + 10
                          : hex && c >= 'A' && c <= 'F' ? c - 'A' + 10
                                                        : -1;
        if (digit < 0) {
            return false;
        }
        code = code * (hex ? 16 : 10) + static_cast<unsigned>(digit);
    }
    // A character of the 8-bit strings of the tree; the others are the general reader's to judge.
    if (digits == 0 || code == 0 || code > 0xff || !eat(";")) {
        return false;
    }
    out.push_back(static_cast<char>(code));
    return true;
}

bool XmlDirectReader::base64(std::string_view encoded, std::string_view& out) {
    std::size_t len = 0;
    m_decoded = Base64Coder::Decode(encoded.data(), encoded.size(), len);
    out = len == 0 ? std::string_view("", 0)  // never a null pointer, even when empty
                   : std::string_view(reinterpret_cast<const char*>(m_decoded.get()), len);
    return true;
}

}  // namespace Vesk
