// CONFIGURATION_CLASS(T): the one declaration every configuration class makes, first in its body:
//     class CONFIGURATION_API AnonParam : public virtual Vesk::Serializable {
//         CONFIGURATION_CLASS(AnonParam);
//     public:
//         ...accessors...
//     private:
//         ...fields...
//     };
// It declares readVesk and writeVesk (overriding Vesk::Serializable, so the exported virtual slots
// stay destructor, readVesk, writeVesk), the free operator== and operator!= of T, and the private
// field list that the library's convention reads, writes and compares. Copying, assignment and
// destruction are the compiler's own. The access after the macro is private. The library defines
// the declared members in one line (CONFIGURATION_DEFINE, inside the library).
#pragma once

#include "Configuration/Export.h"
#include "Configuration/FieldAccess.h"
#include "Quorvex/auto_ptr.h"
#include "Vesk/Element.h"
#include "Vesk/Serializable.h"

#define CONFIGURATION_CLASS(T)                                                         \
public:                                                                                \
    /* Fills the object from its element; true when every expected key was present. */ \
    bool readVesk(const Vesk::Element& element) override;                              \
    /* A new element holding every field, in order; the caller owns it. */             \
    Quorvex::auto_ptr<Vesk::Element> writeVesk() const override;                       \
    /* Equal when every field is equal. */                                             \
    friend CONFIGURATION_API bool operator==(const T& a, const T& b);                  \
    friend bool operator!=(const T& a, const T& b) {                                   \
        return !(a == b);                                                              \
    }                                                                                  \
                                                                                       \
private:                                                                               \
    friend struct ::Configuration::Fields::Access;                                     \
    template <class Self, class Io>                                                    \
    static void fields(Self& self, Io& io)
