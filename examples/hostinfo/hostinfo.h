#pragma once

// The functions that hostinfo.xml names: the whole interface of libhostinfo.so.
//
// `out` is a buffer of 1024 bytes that the caller owns. An instance index that the last count did
// not cover gives 0, an empty text or an empty array. Functions that fill `out` return 0; nobody
// reads it. Any of them may be called from several threads at once.

#include <commonprovider/plugin.h>

/// Takes the first snapshot of every class. Returns 0.
CP_FUNCTION(getI, hostInit);

// Host_FileSystem. The count looks at the host anew; the others read what it saw.
CP_FUNCTION(getI, hostFileSystemCount);
CP_FUNCTION(getSi, hostFileSystemName);
CP_FUNCTION(getSi, hostFileSystemDevice);
CP_FUNCTION(getSi, hostFileSystemType);
/// KiB. Where long has 32 bits the largest answer is 2147483647, just under 2 TiB.
CP_FUNCTION(getLi, hostFileSystemSizeKiB);
/// KiB that users other than root can still fill; the same limit.
CP_FUNCTION(getLi, hostFileSystemFreeKiB);
/// 0 to 100, rounded up, without the blocks that are reserved for root: what df prints.
CP_FUNCTION(getIi, hostFileSystemPercentUsed);
CP_FUNCTION(getIi, hostFileSystemReadOnly);
/// String array. Options that do not fit the buffer any more are left out.
CP_FUNCTION(getASi, hostFileSystemMountOptions);
/// A note that clients set, at most 1023 bytes; it is kept in a file (notes.h).
CP_FUNCTION(getSi, hostFileSystemOwner);
/// An empty text removes the note. 1, and the old note stays, when it could not be stored.
CP_FUNCTION(setSi, hostFileSystemSetOwner);

/// What the methods return.
enum {
  kMethodYes = 0,
  kMethodNo = 1,
  kMethodBadInput = 2,   ///< Without outputs.
  kMethodNoInstance = 3  ///< Without outputs.
};

/// In: a type ("" or left out: any) and a limit (0 or left out: none). Out: the number of file
/// systems of that type, then the names of the first of them, as an array: as many as the limit and
/// the buffer allow. kMethodNo when that is not all. Looks at the host anew.
CP_FUNCTION(execC, hostFileSystemFindByType);
/// In: MiB. Out: whether that much is free for users other than root, the free MiB, the name.
CP_FUNCTION(execCi, hostFileSystemCheckSpace);

// Host_NetworkPort.
CP_FUNCTION(getI, hostNetworkPortCount);
CP_FUNCTION(getSi, hostNetworkPortName);
/// Empty when the address is not the device's own but was set by software.
CP_FUNCTION(getSi, hostNetworkPortPermanentAddress);
CP_FUNCTION(getSi, hostNetworkPortCurrentAddress);
CP_FUNCTION(getIi, hostNetworkPortMTU);
CP_FUNCTION(getIi, hostNetworkPortUp);
/// Mbit/s; 0 when the port does not tell.
CP_FUNCTION(getIi, hostNetworkPortSpeedMbps);
/// Int array: KiB received, KiB sent, packets received, packets sent; each at most 2147483647.
CP_FUNCTION(getAIi, hostNetworkPortTraffic);

// Host_IPEndpoint.
CP_FUNCTION(getI, hostIPEndpointCount);
/// Port, ":" and address; "/" and the prefix length too when that alone tells two apart.
CP_FUNCTION(getSi, hostIPEndpointName);
CP_FUNCTION(getSi, hostIPEndpointAddress);
CP_FUNCTION(getIi, hostIPEndpointPrefixLength);
/// 4 or 6.
CP_FUNCTION(getIi, hostIPEndpointProtocolIFType);
CP_FUNCTION(getSi, hostIPEndpointPortName);
