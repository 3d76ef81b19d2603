#pragma once

#include <Pegasus/Common/Linkage.h>

#define PEGASUS_NAMESPACE_BEGIN namespace Pegasus {
#define PEGASUS_NAMESPACE_END }
#define PEGASUS_USING_PEGASUS using namespace Pegasus
#define PEGASUS_USING_STD using namespace std
#define PEGASUS_STD(X) std::X

#define PEGASUS_UINT64_LITERAL(X) (Uint64(X##ULL))
#define PEGASUS_SINT64_LITERAL(X) (Sint64(X##LL))

// Written without a namespace on purpose: the place of use decides where Uint32 is found.
#define PEG_NOT_FOUND Uint32(-1)

PEGASUS_NAMESPACE_BEGIN

typedef bool Boolean;
typedef unsigned char Uint8;
typedef signed char Sint8;
typedef unsigned short Uint16;
typedef short Sint16;
typedef unsigned int Uint32;
typedef int Sint32;
typedef unsigned long long Uint64;
typedef long long Sint64;
typedef float Real32;
typedef double Real64;

static_assert(sizeof(Boolean) == 1 && sizeof(Uint8) == 1 && sizeof(Sint8) == 1, "8-bit types");
static_assert(sizeof(Uint16) == 2 && sizeof(Sint16) == 2, "16-bit types");
static_assert(sizeof(Uint32) == 4 && sizeof(Sint32) == 4 && sizeof(Real32) == 4, "32-bit types");
static_assert(sizeof(Uint64) == 8 && sizeof(Sint64) == 8 && sizeof(Real64) == 8, "64-bit types");

PEGASUS_NAMESPACE_END
