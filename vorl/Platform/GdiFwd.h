#ifndef VORL_PLATFORM_GDIFWD_H
#define VORL_PLATFORM_GDIFWD_H

/// @file
/// Forward declarations of the device interface's integer point and rectangle, for classes that
/// name them in signatures only. `vorl/Platform/Gdi.h` defines them.

struct tagPOINT;
struct tagRECT;

#endif
