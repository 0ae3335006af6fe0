#ifndef VORL_TESTS_DEVICE_DEVICE_H
#define VORL_TESTS_DEVICE_DEVICE_H

// The device under test: the system's where there is one, the library's elsewhere. The program is
// built for both, and both have to print the same.

#if defined(_WIN32)
#if !defined(NOMINMAX)
#define NOMINMAX
#endif
#include <windows.h>
#else
#include <vorl/Platform/Gdi.h>
#endif

#endif
