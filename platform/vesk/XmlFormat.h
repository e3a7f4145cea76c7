// XmlFormat: the names of the XML form of an element tree (docs/XML_FORMAT.md), shared by the
// tree reader and writer.
//
//   <e k="KEY">  an element; k64 instead of k when the key is written in Base64
//   <a n="" v=""/>  one attribute of the element (n64 / v64 for Base64), before its value
//   <s>text</s>  a single value; <s64> when the text is written in Base64
//   <m>...</m>   a multi value: s, s64, m and l nodes
//   <l>...</l>   a multi-element value: e nodes
//
// A string is written in Base64 only when it holds a byte that XML 1.0 cannot carry.
#pragma once

namespace Vesk {
namespace XmlFormat {

constexpr const char* kDeclaration = "<?xml version=\"1.0\" encoding=\"ISO-8859-1\"?>";

enum class Tag { Element, Attribute, Single, Single64, Multi, List, Unknown };

// The tag of a node name.
inline Tag classify(const char* name) {
    switch (name[0]) {
        case 'e':
            return name[1] == '\0' ? Tag::Element : Tag::Unknown;
        case 'a':
            return name[1] == '\0' ? Tag::Attribute : Tag::Unknown;
        case 'm':
            return name[1] == '\0' ? Tag::Multi : Tag::Unknown;
        case 'l':
            return name[1] == '\0' ? Tag::List : Tag::Unknown;
        case 's':
            if (name[1] == '\0') {
                return Tag::Single;
            }
            return name[1] == '6' && name[2] == '4' && name[3] == '\0' ? Tag::Single64
                                                                       : Tag::Unknown;
        default:
            return Tag::Unknown;
    }
}

}  // namespace XmlFormat
}  // namespace Vesk
