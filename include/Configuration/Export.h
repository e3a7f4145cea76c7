// CONFIGURATION_API marks what libConfiguration.so exports; everything else stays hidden.
#pragma once

#if defined(CONFIGURATION_BUILDING_LIBRARY) || defined(CONFIGURATION_USING_SHARED)
#define CONFIGURATION_API __attribute__((visibility("default")))
#else
#define CONFIGURATION_API __attribute__((visibility("default")))
#endif
