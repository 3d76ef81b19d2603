#pragma once

// The functions that hostinfo.xml names: the whole interface of libhostinfo.so.
//
// `out` is a buffer of 1024 bytes that the caller owns. An instance index that the last count did
// not cover gives 0, an empty text or an empty array. Functions that fill `out` return 0; nobody
// reads it. Any of them may be called from several threads at once.

#ifdef __cplusplus
extern "C" {
#endif

#define HOSTINFO_API __attribute__((visibility("default")))

/// Takes the first snapshot of every class. Returns 0.
HOSTINFO_API int hostInit(void);

// Host_FileSystem. The count looks at the host anew; the others read what it saw.
HOSTINFO_API int hostFileSystemCount(void);
HOSTINFO_API int hostFileSystemName(void* out, int index);
HOSTINFO_API int hostFileSystemDevice(void* out, int index);
HOSTINFO_API int hostFileSystemType(void* out, int index);
/// KiB. Where long has 32 bits the largest answer is 2147483647, just under 2 TiB.
HOSTINFO_API long hostFileSystemSizeKiB(int index);
/// KiB that users other than root can still fill; the same limit.
HOSTINFO_API long hostFileSystemFreeKiB(int index);
/// 0 to 100, rounded up, without the blocks that are reserved for root: what df prints.
HOSTINFO_API int hostFileSystemPercentUsed(int index);
HOSTINFO_API int hostFileSystemReadOnly(int index);
/// String array. Options that do not fit the buffer any more are left out.
HOSTINFO_API int hostFileSystemMountOptions(void* out, int index);

// Host_NetworkPort.
HOSTINFO_API int hostNetworkPortCount(void);
HOSTINFO_API int hostNetworkPortName(void* out, int index);
/// Empty when the address is not the device's own but was set by software.
HOSTINFO_API int hostNetworkPortPermanentAddress(void* out, int index);
HOSTINFO_API int hostNetworkPortCurrentAddress(void* out, int index);
HOSTINFO_API int hostNetworkPortMTU(int index);
HOSTINFO_API int hostNetworkPortUp(int index);
/// Mbit/s; 0 when the port does not tell.
HOSTINFO_API int hostNetworkPortSpeedMbps(int index);
/// Int array: KiB received, KiB sent, packets received, packets sent; each at most 2147483647.
HOSTINFO_API int hostNetworkPortTraffic(void* out, int index);

// Host_IPEndpoint.
HOSTINFO_API int hostIPEndpointCount(void);
/// Port, ":" and address; "/" and the prefix length too when that alone tells two apart.
HOSTINFO_API int hostIPEndpointName(void* out, int index);
HOSTINFO_API int hostIPEndpointAddress(void* out, int index);
HOSTINFO_API int hostIPEndpointPrefixLength(int index);
/// 4 or 6.
HOSTINFO_API int hostIPEndpointProtocolIFType(int index);
HOSTINFO_API int hostIPEndpointPortName(void* out, int index);

#ifdef __cplusplus
}
#endif
