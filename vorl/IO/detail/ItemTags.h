#ifndef VORL_IO_DETAIL_ITEMTAGS_H
#define VORL_IO_DETAIL_ITEMTAGS_H

#include <cstdint>

inline namespace vorl {
namespace vorl_detail {

inline constexpr char kMagic[4] = {'B', 'D', 'F', '\0'};
inline constexpr char kUnnamedType[] = "???";
/// A reader takes at most so many bytes of the type name, its zero byte included.
inline constexpr int kMaxTypeBytes = 501;

inline constexpr unsigned char kTagBlockEnd = 0x00;
inline constexpr unsigned char kTagU8 = 0x01;
inline constexpr unsigned char kTagS8 = 0x02;
inline constexpr unsigned char kTagU16 = 0x03;
inline constexpr unsigned char kTagS16 = 0x04;
inline constexpr unsigned char kTagU32 = 0x05;
inline constexpr unsigned char kTagS32 = 0x06;
inline constexpr unsigned char kTagF32 = 0x07;
inline constexpr unsigned char kTagF64 = 0x08;
inline constexpr unsigned char kTagBool = 0x09;
inline constexpr unsigned char kTagBlock = 0xF0;

/// Items that carry a count: the low three bits of their tag say how many bytes it has (1, 2, 4).
inline constexpr unsigned char kTagFamilyLength = 0xE0;
inline constexpr unsigned char kTagFamilyNumberedBlock = 0xF0;
inline constexpr unsigned char kCountSizeMask = 7;

/// The codes of the streams' errors; `BinaryDataIO.h` says what they mean.
inline constexpr long kErrorNoFileName = -2;
inline constexpr long kErrorCannotOpen = -3;
inline constexpr long kErrorNotOpen = -4;
inline constexpr long kErrorWrite = -100;
inline constexpr long kErrorShortRead = -200;
inline constexpr long kErrorEndOfFile = -201;
inline constexpr long kErrorType = -202;
inline constexpr long kErrorMagic = -203;
inline constexpr long kErrorNoLength = -204;
inline constexpr long kErrorNoNumberedBlock = -205;
inline constexpr long kErrorTag = -206;
inline constexpr long kErrorBlockId = -207;
inline constexpr long kErrorBufferSize = -208;

}  // namespace vorl_detail
}  // namespace vorl

#endif
