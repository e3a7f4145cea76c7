// CONFIGURATION_API marks what libConfiguration.so exports. The library is compiled with hidden
// visibility, so only the classes and functions marked here are visible to its users; a user's
// compilation sees the same attribute, which on Linux both exports and imports.
#pragma once

#define CONFIGURATION_API __attribute__((visibility("default")))
