// libyuv: stretching without a filter.
#include <libyuv.h>

#include <memory>

#include "Checks.h"
#include "Contest.h"
#include "Works.h"

namespace peers {
namespace {

void Stretch(const StretchWork& work, std::uint8_t* screen) {
  const auto* const source = static_cast<const std::uint8_t*>(SourceOf(work));
  const int edge = work.sourceEdge;
  if (work.bytes == 1) {
    libyuv::ScalePlane(source, edge, edge, edge, screen, kScreenWidth, kScreenWidth, kScreenHeight,
                       libyuv::kFilterNone);
  } else {
    libyuv::ARGBScale(source, 4 * edge, edge, edge, screen, 4 * kScreenWidth, kScreenWidth,
                      kScreenHeight, libyuv::kFilterNone);
  }
}

}  // namespace

void EnterLibyuv() {
  for (const StretchWork& work : StretchWorks()) {
    Enter(work.work, "libyuv", [work] {
      const auto screen = std::make_shared<Samples<std::uint8_t>>(
          kScreenPixels * static_cast<std::size_t>(work.bytes));
      return Contender{[=] {
                         Stretch(work, screen->data());
                         return true;
                       },
                       [=] { return CheckStretch(work, screen->data()); }};
    });
  }
}

}  // namespace peers
