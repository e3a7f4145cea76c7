// Configuration::SOPObjectType: the kind of object a SOP service stores, and the fixed text of
// each kind as the SOP service document spells it. "SPECIAL" belongs to the same family of texts
// but names no kind: a service that says "SPECIAL" stores "IMAGE" objects. Constants and a pure
// function; thread-safe.
#pragma once

namespace Configuration {

enum SOPObjectType {
    SOPObjectTypeImage = 0,
    SOPObjectTypeGSPS = 1,
    SOPObjectTypeSR = 2,
    SOPObjectTypeKO = 3,
    SOPObjectTypePrivate = 4,
    SOPObjectTypeCSPS = 5,
};

namespace SOPObjectTypeText {

constexpr const char kImage[] = "IMAGE";
constexpr const char kGSPS[] = "GSPS";
constexpr const char kSR[] = "SR";
constexpr const char kKO[] = "KO";
constexpr const char kPrivate[] = "PRIVATE";
constexpr const char kCSPS[] = "CSPS";
// Defined beside the others but mapped to no kind: reading it gives SOPObjectTypeImage.
constexpr const char kSpecial[] = "SPECIAL";

}  // namespace SOPObjectTypeText

// The text of a kind; a value outside the enumeration is "IMAGE".
inline const char* sopObjectTypeText(SOPObjectType type) {
    switch (type) {
        case SOPObjectTypeGSPS:
            return SOPObjectTypeText::kGSPS;
        case SOPObjectTypeSR:
            return SOPObjectTypeText::kSR;
        case SOPObjectTypeKO:
            return SOPObjectTypeText::kKO;
        case SOPObjectTypePrivate:
            return SOPObjectTypeText::kPrivate;
        case SOPObjectTypeCSPS:
            return SOPObjectTypeText::kCSPS;
        default:
            return SOPObjectTypeText::kImage;
    }
}

}  // namespace Configuration
