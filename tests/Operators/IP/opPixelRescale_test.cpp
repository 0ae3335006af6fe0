#include <vorl/Operators/IP/opPixelRescale.h>

#include <gtest/gtest.h>

#include <limits>

#include "../../Support/LogRecorder.h"
#include "Rasters.h"

namespace {

using rasters::Bytes;
using rasters::BytesOf;
using rasters::CodeOf;
using rasters::Format;
using rasters::Make;
using rasters::MakeOf;
using rasters::MessageOf;
using rasters::SamplesOf;

/// One sample, rescaled into a separate target.
template <class T>
T Rescaled(T sample, unsigned short type, double factor, double offset) {
  dImage source;
  MakeOf<T>(source, {.type = type}, {sample});
  dImage target;
  EXPECT_EQ(MessageOf(opPixelRescale(&source, &target, factor, offset)), "success");
  EXPECT_EQ(target.GetDataType(), type);
  EXPECT_EQ(SamplesOf<T>(source).front(), sample) << "the source stays";
  return SamplesOf<T>(target).front();
}

TEST(opPixelRescale, IsRegisteredBelowTheOperatorBase) {
  rasters::ExpectRegistered<opPixelRescale>("opPixelRescale");
}

TEST(opPixelRescale, ResetRestoresTheIdentity) {
  dImage image;
  opPixelRescale op;
  op.Run(&image, &image, 2.0, 3.0);
  EXPECT_TRUE(op.Reset());
  EXPECT_EQ(op.m_pSource, nullptr);
  EXPECT_EQ(op.m_pTarget, nullptr);
  EXPECT_EQ(op.m_factor, 1.0);
  EXPECT_EQ(op.m_offset, 0.0);
}

TEST(opPixelRescale, CopiesCarryTheOperands) {
  dImage image;
  MakeOf<std::uint8_t>(image, {}, {1});
  dImage target;
  const opPixelRescale op(&image, &target, 2.0, 3.0);
  const opPixelRescale copy(op);
  opPixelRescale assigned;
  assigned = op;
  for (const opPixelRescale* other : {&copy, static_cast<const opPixelRescale*>(&assigned)}) {
    EXPECT_EQ(other->m_pSource, &image);
    EXPECT_EQ(other->m_pTarget, &target);
    EXPECT_EQ(other->m_factor, 2.0);
    EXPECT_EQ(other->m_offset, 3.0);
    EXPECT_EQ(MessageOf(*other), "success");
  }
}

TEST(opPixelRescale, SaturatesToTheTypeOfTheSource) {
  EXPECT_EQ(Rescaled<std::uint8_t>(3, ImageDataType_U8, 2.0, -10.0), 0);
  EXPECT_EQ(Rescaled<std::uint8_t>(200, ImageDataType_U8, 2.0, -10.0), 255);
  EXPECT_EQ(Rescaled<std::int8_t>(-100, ImageDataType_S8, 2.0, -10.0), -128);
  EXPECT_EQ(Rescaled<std::int8_t>(100, ImageDataType_S8, 2.0, -10.0), 127);
  EXPECT_EQ(Rescaled<std::uint16_t>(3, ImageDataType_U16, 2.0, -10.0), 0);
  EXPECT_EQ(Rescaled<std::uint16_t>(40000, ImageDataType_U16, 2.0, -10.0), 65535);
  EXPECT_EQ(Rescaled<std::int16_t>(-20000, ImageDataType_S16, 2.0, -10.0), -32768);
  EXPECT_EQ(Rescaled<std::int16_t>(20000, ImageDataType_S16, 2.0, -10.0), 32767);
}

TEST(opPixelRescale, TruncatesTowardsZero) {
  EXPECT_EQ(Rescaled<std::int16_t>(3, ImageDataType_S16, 0.5, 0.0), 1);
  EXPECT_EQ(Rescaled<std::int16_t>(-3, ImageDataType_S16, 0.5, 0.0), -1);
  EXPECT_EQ(Rescaled<std::uint8_t>(9, ImageDataType_U8, 0.1, 0.0), 0);
  EXPECT_EQ(Rescaled<std::uint8_t>(0, ImageDataType_U8, 1.0, -0.9), 0);
  EXPECT_EQ(Rescaled<std::uint8_t>(255, ImageDataType_U8, 1.0, 0.9), 255);
  EXPECT_EQ(Rescaled<std::int8_t>(-128, ImageDataType_S8, 1.0, -0.9), -128);
}

TEST(opPixelRescale, ResultsBeyondAllBoundsSaturateAndWhatIsNoNumberIsZero) {
  const double infinity = std::numeric_limits<double>::infinity();
  const double nan = std::numeric_limits<double>::quiet_NaN();
  EXPECT_EQ(Rescaled<std::uint16_t>(5, ImageDataType_U16, 1e300, 0.0), 65535);
  EXPECT_EQ(Rescaled<std::uint16_t>(5, ImageDataType_U16, -1e300, 0.0), 0);
  EXPECT_EQ(Rescaled<std::int16_t>(-5, ImageDataType_S16, 1e300, 0.0), -32768);
  EXPECT_EQ(Rescaled<std::int8_t>(1, ImageDataType_S8, infinity, 0.0), 127);
  EXPECT_EQ(Rescaled<std::int8_t>(1, ImageDataType_S8, 2.0, -infinity), -128);
  EXPECT_EQ(Rescaled<std::int8_t>(0, ImageDataType_S8, infinity, 0.0), 0);
  EXPECT_EQ(Rescaled<std::uint8_t>(7, ImageDataType_U8, nan, 0.0), 0);
  EXPECT_EQ(Rescaled<std::int16_t>(7, ImageDataType_S16, 1.0, nan), 0);
}

TEST(opPixelRescale, WorksInPlaceWithoutATarget) {
  dImage image;
  MakeOf<std::uint8_t>(image, {.width = 3}, {1, 2, 3});
  opPixelRescale op;
  EXPECT_TRUE(op.Run(&image, nullptr, 2.0, 1.0));
  EXPECT_EQ(op.m_pTarget, &image);
  EXPECT_EQ(BytesOf(image), (Bytes{3, 5, 7}));
  EXPECT_EQ(MessageOf(opPixelRescale(&image, 1.0, 10.0)), "success");
  EXPECT_EQ(BytesOf(image), (Bytes{13, 15, 17}));
}

TEST(opPixelRescale, TheIdentityLeavesASeparateTargetUnwritten) {
  dImage source;
  MakeOf<std::uint8_t>(source, {.width = 3}, {1, 2, 3});
  dImage target;
  MakeOf<std::uint8_t>(target, {.width = 3}, {7, 8, 9});
  opPixelRescale op;
  EXPECT_TRUE(op.Run(&source, &target, 1.0, 0.0));
  EXPECT_EQ(op.m_pTarget, &source);
  EXPECT_EQ(BytesOf(target), (Bytes{7, 8, 9}));
}

TEST(opPixelRescale, TheIdentityAsksForNoDataType) {
  dImage image;
  Make(image, {.type = ImageDataType_F64});
  EXPECT_EQ(MessageOf(opPixelRescale(&image, 1.0, 0.0)), "success");
}

TEST(opPixelRescale, RescalesThePaddingAsPartOfOneDenseRun) {
  dImage source;
  MakeOf<std::uint8_t>(source, {.width = 4, .height = 3, .alignment = 4},
                       {1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11, 12});
  // The same bytes as rows of three samples and one byte of padding: 9 of 12 bytes are rescaled.
  const Format padded = {.width = 3, .height = 3, .alignment = 4};
  Make(source, padded);
  dImage target;
  Make(target, padded);
  target.Fill(99);
  EXPECT_EQ(MessageOf(opPixelRescale(&source, &target, 10.0, 0.0)), "success");
  EXPECT_EQ(BytesOf(target), (Bytes{10, 20, 30, 40, 50, 60, 70, 80, 90, 99, 99, 99}));
}

void ExpectFailure(dImage* source, dImage* target, long code, const std::string& title,
                   const std::string& message) {
  LogRecorder log;
  opPixelRescale op;
  EXPECT_FALSE(op.Run(source, target, 2.0, 0.0));
  EXPECT_EQ(CodeOf(op), code);
  EXPECT_EQ(MessageOf(op), message);
  ASSERT_FALSE(log.errors.empty());
  EXPECT_EQ(log.errors.back(), title + ": " + message);
  EXPECT_EQ(log.errorCodes.back(), code);
}

TEST(opPixelRescale, ReportsMissingAndUnformattableImages) {
  const char* prepare = "opPixelRescale::Prepare";
  dImage source;
  dImage target;
  ExpectFailure(nullptr, &target, -1, prepare, "uninitialized parameter: m_pSource = null");
  ExpectFailure(&source, &target, -1, prepare,
                "error while initializing target image: invalid 'ChannelSequence':''");
  Make(source, {.type = ImageDataType_F64});
  rasters::StubbornImage stubborn;
  ExpectFailure(&source, &stubborn, -7, prepare, "error while initializing target image: no room");
}

TEST(opPixelRescale, RefusesEveryOtherDataTypeByName) {
  const std::pair<unsigned short, const char*> cases[] = {
      {ImageDataType_U1, "1 bit unsigned"},        {ImageDataType_U32, "32 bit unsigned"},
      {ImageDataType_U64, "64 bit unsigned"},      {ImageDataType_S32, "32 bit signed"},
      {ImageDataType_S64, "64 bit signed"},        {ImageDataType_F32, "32 bit floating point"},
      {ImageDataType_F64, "64 bit floating point"}};
  for (const auto& [type, name] : cases) {
    dImage image;
    Make(image, {.type = type});
    ExpectFailure(&image, nullptr, -1, "opPixelRescale::Process",
                  std::string("unsupported pixel data type: ") + name);
  }
}

TEST(opPixelRescale, RefusesBuffersThatDoNotHoldTheRun) {
  const char* process = "opPixelRescale::Process";
  const Format format = {.width = 3, .height = 2, .type = ImageDataType_U16, .alignment = 4};
  dImage source;
  Make(source, format);
  alignas(2) unsigned char memory[32] = {};
  source.GetDataBuffer().Init(memory, 11, DTM_Reference);
  ExpectFailure(&source, nullptr, -1, process, "invalid pixel data in the source image");
  source.GetDataBuffer().Init(memory + 1, 16, DTM_Reference);
  ExpectFailure(&source, nullptr, -1, process, "invalid pixel data in the source image");
  dImage whole;
  Make(whole, format);
  dImage target;
  Make(target, format);
  target.GetDataBuffer().Init(memory + 1, 16, DTM_Reference);
  ExpectFailure(&whole, &target, -1, process, "invalid pixel data in the target image");
}

TEST(opPixelRescale, AnImageWithoutPixelsIsLeftAlone) {
  dImage image;
  EXPECT_EQ(MessageOf(opPixelRescale(&image, 2.0, 0.0)), "success");
  EXPECT_FALSE(image.IsValid());
}

class Rescaler : public opPixelRescale {
 public:
  using opPixelRescale::RescaleS16;
  using opPixelRescale::RescaleS8;
  using opPixelRescale::RescaleU16;
  using opPixelRescale::RescaleU8;
};

TEST(opPixelRescale, TheWorkersLeaveNullImagesAlone) {
  dImage image;
  MakeOf<std::uint8_t>(image, {.width = 2}, {1, 2});
  Rescaler op;
  EXPECT_TRUE(op.RescaleU8(nullptr, &image, 2.0, 0.0));
  EXPECT_TRUE(op.RescaleU16(nullptr, &image, 2.0, 0.0));
  EXPECT_TRUE(op.RescaleS8(&image, nullptr, 2.0, 0.0));
  EXPECT_TRUE(op.RescaleS16(&image, nullptr, 2.0, 0.0));
  EXPECT_EQ(BytesOf(image), (Bytes{1, 2}));
}

TEST(opPixelRescale, StoppedLeavesThePixelsAndSaysSo) {
  dImage image;
  MakeOf<std::uint8_t>(image, {.width = 2}, {1, 2});
  LogRecorder log;
  rasters::StoppedBeforeWork<opPixelRescale> op;
  EXPECT_FALSE(op.Run(&image, nullptr, 2.0, 0.0));
  EXPECT_EQ(CodeOf(op), -1);
  EXPECT_EQ(MessageOf(op), "stopped");
  ASSERT_EQ(log.errors.size(), 1u);
  EXPECT_EQ(log.errors.front(), "opPixelRescale::Process: stopped");
  EXPECT_EQ(BytesOf(image), (Bytes{1, 2}));
}

}  // namespace
