// Configuration::TypedConfigDoc<Derived>: the base a top-level configuration class derives from
// (class LocationConfiguration : public TypedConfigDoc<LocationConfiguration>). It supplies the
// polymorphic copy operations of ConfigDoc from Derived's own copy constructor and assignment.
#pragma once

#include "Configuration/ConfigDoc.h"

namespace Configuration {

template <class Derived>
class TypedConfigDoc : public ConfigDoc {
public:
    using ConfigDoc::ConfigDoc;

    ConfigDoc* clone() const override { return new Derived(static_cast<const Derived&>(*this)); }
    void assignFrom(const ConfigDoc& other) override {
        static_cast<Derived&>(*this) = dynamic_cast<const Derived&>(other);
    }
};

}  // namespace Configuration
