// Configuration::SOPObjectType: the kind of object a SOP service stores, and the fixed text of
// each kind as the SOP service document spells it. "SPECIAL" belongs to the same family of texts
// but names no kind: a service that says "SPECIAL" stores "IMAGE" objects. Constants; thread-safe.
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
}  // namespace Configuration
