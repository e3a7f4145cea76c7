// Defines what CONFIGURATION_CLASS(T) declares, in one line of T's .cpp:
//     CONFIGURATION_DEFINE(AnonParam, "AnonParam", Fields::FailureForm::Failed)
// readVesk reads T's field list and logs a failure with the class name spelt from T itself, so the
// log text cannot drift from the class; writeVesk writes the element named elementName; operator==
// compares the field list. The parts can be used alone by a class with a quirk of its own:
// CONFIGURATION_DEFINE_READ, CONFIGURATION_DEFINE_WRITE, CONFIGURATION_DEFINE_EQUAL, and
// CONFIGURATION_DEFINE_NO_WRITE for a read-only class whose writeVesk throws a std::exception
// with a fixed text. CONFIGURATION_DEFINE_INLINE defines the same inline, for a class defined
// wholly in a header (test documents).
#pragma once

#include "Configuration/ConfigurationClass.h"
#include "Fields.h"

#define CONFIGURATION_DEFINE_READ_AS(specifier, T, failureForm)                \
    specifier bool T::readVesk(const Vesk::Element& element) {                 \
        return ::Configuration::Fields::read(*this, element, #T, failureForm); \
    }

#define CONFIGURATION_DEFINE_WRITE_AS(specifier, T, elementName)      \
    specifier Quorvex::auto_ptr<Vesk::Element> T::writeVesk() const { \
        return ::Configuration::Fields::write(*this, elementName);    \
    }

#define CONFIGURATION_DEFINE_EQUAL_AS(specifier, T)     \
    specifier bool operator==(const T& a, const T& b) { \
        return ::Configuration::Fields::equal(a, b);    \
    }

#define CONFIGURATION_DEFINE_READ(T, failureForm) CONFIGURATION_DEFINE_READ_AS(, T, failureForm)
#define CONFIGURATION_DEFINE_WRITE(T, elementName) CONFIGURATION_DEFINE_WRITE_AS(, T, elementName)
#define CONFIGURATION_DEFINE_EQUAL(T) CONFIGURATION_DEFINE_EQUAL_AS(, T)

#define CONFIGURATION_DEFINE_NO_WRITE(T, refusalText)             \
    Quorvex::auto_ptr<Vesk::Element> T::writeVesk() const {       \
        throw ::Configuration::Fields::WriteRefused(refusalText); \
    }

#define CONFIGURATION_DEFINE(T, elementName, failureForm) \
    CONFIGURATION_DEFINE_READ(T, failureForm)             \
    CONFIGURATION_DEFINE_WRITE(T, elementName)            \
    CONFIGURATION_DEFINE_EQUAL(T)

#define CONFIGURATION_DEFINE_INLINE(T, elementName, failureForm) \
    CONFIGURATION_DEFINE_READ_AS(inline, T, failureForm)         \
    CONFIGURATION_DEFINE_WRITE_AS(inline, T, elementName)        \
    CONFIGURATION_DEFINE_EQUAL_AS(inline, T)
