// Vesk::Ordering: how XmlUtils::streamOut lays out a tree. Children are always written in their
// order in the tree; the default layout is compact (no whitespace between elements), Indented adds
// line breaks and indentation for people to read. Both forms parse to the same tree.
#pragma once

namespace Vesk {

class Ordering {
public:
    enum class Layout { Compact, Indented };
    explicit Ordering(Layout layout = Layout::Compact) : m_layout(layout) {}
    Layout layout() const { return m_layout; }
    static Ordering indented() { return Ordering(Layout::Indented); }

private:
    Layout m_layout;
};

}  // namespace Vesk
