#ifndef VORL_EXPORT_H
#define VORL_EXPORT_H

/// @file
/// `VORL_API` marks what the library exports. Everything else stays hidden inside the shared
/// library. A static build defines `VORL_STATIC` for itself and for its users.

#if defined(VORL_STATIC)
#define VORL_API
#elif defined(_WIN32)
#if defined(VORL_BUILDING)
#define VORL_API __declspec(dllexport)
#else
#define VORL_API __declspec(dllimport)
#endif
#else
#define VORL_API __attribute__((visibility("default")))
#endif

/// Lets the compiler check the arguments of a printf-style member function inside the library.
/// `formatIndex` and `firstArgument` count from 1 and include the implicit `this`. Applications may
/// pass null and empty formats, which the check would reject.
#if defined(VORL_BUILDING) && defined(__MINGW32__)
#define VORL_PRINTF_FORMAT(formatIndex, firstArgument) \
  __attribute__((format(gnu_printf, formatIndex, firstArgument)))
#elif defined(VORL_BUILDING) && defined(__GNUC__)
#define VORL_PRINTF_FORMAT(formatIndex, firstArgument) \
  __attribute__((format(printf, formatIndex, firstArgument)))
#else
#define VORL_PRINTF_FORMAT(formatIndex, firstArgument)
#endif

#endif
