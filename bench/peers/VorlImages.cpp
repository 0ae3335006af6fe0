// vorl: operators on images, and stretching them onto a device.
#include <vorl/Data/dDIB.h>
#include <vorl/Data/dImaDescriptorDIB.h>
#include <vorl/Data/dWindowingLUT.h>
#include <vorl/Operators/IP/opLookup.h>
#include <vorl/Operators/IP/opMinMax.h>
#include <vorl/Operators/IP/opPixelRescale.h>
#include <vorl/Platform/Gdi.h>

#include <algorithm>
#include <cstring>
#include <limits>
#include <memory>
#include <vector>

#include "Checks.h"
#include "Contest.h"
#include "Works.h"

namespace peers {
namespace {

constexpr char kName[] = "vorl";

std::shared_ptr<dImage> CopyOf(const void* pixels, int width, int height, unsigned short type,
                               const char* channels = "G") {
  auto image = std::make_shared<dImage>();
  image->Init(static_cast<unsigned long>(width), static_cast<unsigned long>(height), type, channels,
              ImageDataOrder_Pixel, 4);
  std::memcpy(image->GetDataPtr(), pixels, image->GetImageSize());
  return image;
}

Contender Window() {
  struct Operation {
    dWindowingLUT table;
    dImage levels;
    opLookup op;
  };
  const auto source = CopyOf(Image16().data(), kImageEdge, kImageEdge, ImageDataType_U16);
  const auto operation = std::make_shared<Operation>();
  operation->table.SetWindow(TheWindow().centre, TheWindow().width);
  operation->op.m_pSource = source.get();
  operation->op.m_pTarget = &operation->levels;
  operation->op.m_pLUT = &operation->table;
  return {[source, operation] { return operation->op.Run(); },
          [operation] {
            return CheckWindow(static_cast<const std::uint8_t*>(operation->levels.GetDataPtr()));
          }};
}

/// In images of at most 2048 rows, each of which extends the result of those before it.
Contender FindExtremes(const ExtremesWork& work) {
  struct Search {
    std::vector<std::shared_ptr<dImage>> images;
    std::int32_t lowest = 0;
    std::int32_t highest = 0;
  };
  const auto search = std::make_shared<Search>();
  const int height = std::min(work.height, kImageEdge);
  for (int y = 0; y < work.height; y += height) {
    const std::uint16_t* const rows =
        &work.samples()[static_cast<std::size_t>(y) * static_cast<std::size_t>(work.width)];
    search->images.push_back(CopyOf(rows, work.width, height, ImageDataType_U16));
  }
  return {[search] {
            search->lowest = std::numeric_limits<std::int32_t>::max();
            search->highest = std::numeric_limits<std::int32_t>::min();
            opMinMax op;
            for (const std::shared_ptr<dImage>& image : search->images) {
              if (!op.Run(image.get(), search->lowest, search->highest)) {
                return false;
              }
            }
            return true;
          },
          [search, work] { return CheckExtremes(work, search->lowest, search->highest); }};
}

Contender Rescale(const RescaleWork& work) {
  const auto source =
      work.bits == 8 ? CopyOf(Image8(kImageEdge).data(), kImageEdge, kImageEdge, ImageDataType_U8)
                     : CopyOf(Image16().data(), kImageEdge, kImageEdge, ImageDataType_U16);
  const auto target = std::make_shared<dImage>();
  const auto op = std::make_shared<opPixelRescale>();
  return {[=] { return op->Run(source.get(), target.get(), work.scale, work.shift); },
          [=] { return CheckRescale(work, target->GetDataPtr()); }};
}

/// A bitmap, selected into a device context.
class Screen {
 public:
  Screen(int width, int height, int bytes)
      : m_bitmap(width, height, static_cast<short>(bytes), 8),
        m_dc(CreateCompatibleDC(nullptr)),
        m_old(SelectObject(m_dc, m_bitmap.GetHandle())) {
    SetStretchBltMode(m_dc, COLORONCOLOR);
  }
  Screen(const Screen&) = delete;
  Screen& operator=(const Screen&) = delete;
  ~Screen() {
    SelectObject(m_dc, m_old);
    DeleteDC(m_dc);
  }

  HDC GetDC() const { return m_dc; }
  const void* Pixels() const { return m_bitmap.GetDataPtr(); }

 private:
  dDIB m_bitmap;
  HDC m_dc;
  HGDIOBJ m_old;
};

Contender Stretch(const StretchWork& work) {
  const int edge = work.sourceEdge;
  const auto source =
      CopyOf(SourceOf(work), edge, edge, ImageDataType_U8, work.bytes == 1 ? "G" : "BGRA");
  const auto descriptor = std::make_shared<dImaDescriptorDIB>(*source);
  const auto screen = std::make_shared<Screen>(kScreenWidth, kScreenHeight, work.bytes);
  return {[=] {
            (void)source;  // which the descriptor refers to
            return StretchDIBits(screen->GetDC(), 0, 0, kScreenWidth, kScreenHeight, 0, 0, edge,
                                 edge, descriptor->GetPixelData(), descriptor->GetHeader(),
                                 DIB_RGB_COLORS, SRCCOPY) != 0;
          },
          [=] { return CheckStretch(work, screen->Pixels()); }};
}

}  // namespace

void EnterVorlImages() {
  Enter(TheWindow().work, kName, Window);
  for (const ExtremesWork& work : ExtremesWorks()) {
    Enter(work.work, kName, [work] { return FindExtremes(work); });
  }
  for (const RescaleWork& work : RescaleWorks()) {
    Enter(work.work, kName, [work] { return Rescale(work); });
  }
  for (const StretchWork& work : StretchWorks()) {
    Enter(work.work, kName, [work] { return Stretch(work); });
  }
}

}  // namespace peers
