// Vesk::Serializable: the interface of objects that fill themselves from an element tree and
// write themselves back. Every configuration class derives from it virtually.
#pragma once

#include <exception>

#include "Quorvex/auto_ptr.h"
#include "Vesk/Element.h"

namespace Vesk {

class Serializable {
public:
    // Raised by writeVesk when the element tree cannot be built.
    class SerializableEx : public std::exception {
    public:
        const char* what() const noexcept override {
            return "Vesk::Serializable::SerializableEx has occured.";
        }
    };

    virtual ~Serializable() = default;
    // Fills the object from the tree; true only when every expected key was present.
    virtual bool readVesk(const Element& element) = 0;
    // Builds a new tree of the object; the caller owns it.
    virtual Quorvex::auto_ptr<Element> writeVesk() const = 0;
};

}  // namespace Vesk
