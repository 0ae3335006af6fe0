#include <vorl/IO/detail/LittleEndian.h>

#include <gtest/gtest.h>

#include <cstdint>
#include <limits>

namespace {

using vorl::vorl_detail::Fits;
using vorl::vorl_detail::LoadLittleEndian;
using vorl::vorl_detail::StoreLittleEndian;

TEST(LittleEndian, TheLowestByteComesFirst) {
  unsigned char bytes[8];
  StoreLittleEndian(bytes, std::uint32_t{0x12345678});
  EXPECT_EQ(bytes[0], 0x78);
  EXPECT_EQ(bytes[3], 0x12);
  StoreLittleEndian(bytes, std::int16_t{-2});
  EXPECT_EQ(bytes[0], 0xFE);
  EXPECT_EQ(bytes[1], 0xFF);
  EXPECT_EQ(bytes[2], 0x34);      // untouched
  StoreLittleEndian(bytes, 1.0);  // 0x3FF0000000000000
  EXPECT_EQ(bytes[0], 0x00);
  EXPECT_EQ(bytes[6], 0xF0);
  EXPECT_EQ(bytes[7], 0x3F);
}

template <class Number>
void ExpectRoundTrip(Number value) {
  unsigned char bytes[sizeof(Number)];
  StoreLittleEndian(bytes, value);
  EXPECT_EQ(LoadLittleEndian<Number>(bytes), value);
}

TEST(LittleEndian, EveryTypeSurvivesTheRoundTrip) {
  ExpectRoundTrip(std::uint8_t{0xFE});
  ExpectRoundTrip(static_cast<char>(-2));
  ExpectRoundTrip(std::numeric_limits<std::int16_t>::min());
  ExpectRoundTrip(std::numeric_limits<std::uint16_t>::max());
  ExpectRoundTrip(std::numeric_limits<std::int32_t>::min());
  ExpectRoundTrip(std::numeric_limits<std::uint32_t>::max());
  ExpectRoundTrip(-1.5e30f);
  ExpectRoundTrip(-1.5e300);
}

TEST(LittleEndian, FitsKnowsTheLimitsOf32Bits) {
  EXPECT_TRUE((Fits<std::int32_t>(std::int64_t{0x7FFFFFFF})));
  EXPECT_FALSE((Fits<std::int32_t>(std::int64_t{0x80000000})));
  EXPECT_TRUE((Fits<std::int32_t>(-std::int64_t{0x80000000})));
  EXPECT_FALSE((Fits<std::int32_t>(-std::int64_t{0x80000001})));
  EXPECT_TRUE((Fits<std::uint32_t>(std::uint64_t{0xFFFFFFFF})));
  EXPECT_FALSE((Fits<std::uint32_t>(std::uint64_t{0x100000000})));
}

}  // namespace
