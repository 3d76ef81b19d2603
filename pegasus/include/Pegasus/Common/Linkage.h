#pragma once

// Every class whose objects or type information cross a library border carries one of these.
#define PEGASUS_EXPORT __attribute__((visibility("default")))
#define PEGASUS_IMPORT __attribute__((visibility("default")))
#define PEGASUS_COMMON_LINKAGE PEGASUS_EXPORT
#define PEGASUS_PROVIDER_LINKAGE PEGASUS_EXPORT
