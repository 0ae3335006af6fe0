// Images by loops as one writes them without thinking of speed.
#include <algorithm>
#include <array>
#include <cstring>

#include "Checks.h"
#include "Plain.h"
#include "Works.h"

namespace peers {
namespace {

void EnterWindow() {
  const WindowWork& work = TheWindow();
  const auto table = MakeSamples<std::uint8_t>(0x10000);
  const auto levels = MakeSamples<std::uint8_t>(kImagePixels);
  for (int value = 0; value < 0x10000; ++value) {
    const double level = (value - (work.centre - 0.5 * work.width)) * 255 / work.width;
    (*table)[static_cast<std::size_t>(value)] =
        static_cast<std::uint8_t>(std::clamp(level + 0.5, 0.0, 255.0));
  }
  EnterLoop(
      work.work,
      [=] {
        const std::uint16_t* const source = Image16().data();
        std::uint8_t* const target = levels->data();
        const std::uint8_t* const entries = table->data();
        for (std::size_t i = 0; i < kImagePixels; ++i) {
          target[i] = entries[source[i]];
        }
      },
      [=] { return CheckWindow(levels->data()); });
  EnterMemcpy(work.work, Image16().data(), kImagePixels * sizeof(std::uint16_t));
}

void EnterExtremes(const ExtremesWork& work) {
  const auto found = std::make_shared<std::array<std::uint16_t, 2>>();
  EnterLoop(
      work.work,
      [=] {
        std::uint16_t lowest = 0xFFFF;
        std::uint16_t highest = 0;
        for (const std::uint16_t value : work.samples()) {
          lowest = std::min(lowest, value);
          highest = std::max(highest, value);
        }
        *found = {lowest, highest};
      },
      [=] { return CheckExtremes(work, (*found)[0], (*found)[1]); });
  EnterRead(work.work, work.samples().data(), work.samples().size() * sizeof(std::uint16_t));
}

template <class T>
void EnterRescale(const RescaleWork& work, const Samples<T>& source) {
  const auto target = MakeSamples<T>(kImagePixels);
  EnterLoop(
      work.work,
      [=, &source] {
        constexpr double kHighest = static_cast<T>(~T{0});
        const T* const values = source.data();
        T* const results = target->data();
        for (std::size_t i = 0; i < kImagePixels; ++i) {
          const double value = values[i] * work.scale + work.shift;
          results[i] = static_cast<T>(std::clamp(value, 0.0, kHighest));
        }
      },
      [=] { return CheckRescale(work, target->data()); });
  EnterMemcpy(work.work, source.data(), kImagePixels * sizeof(T));
}

/// Through a table of columns; rows that come again are copied.
template <class T>
void Stretch(const StretchWork& work, T* screen) {
  static std::array<int, kScreenWidth> columns;
  for (int x = 0; x < kScreenWidth; ++x) {
    columns[static_cast<std::size_t>(x)] = (2 * x + 1) * work.sourceEdge / (2 * kScreenWidth);
  }
  const auto* const source = static_cast<const T*>(SourceOf(work));
  int last = -1;
  for (int y = 0; y < kScreenHeight; ++y, screen += kScreenWidth) {
    const int row = (2 * y + 1) * work.sourceEdge / (2 * kScreenHeight);
    if (row == last) {
      std::memcpy(screen, screen - kScreenWidth, kScreenWidth * sizeof(T));
      continue;
    }
    last = row;
    const T* const pixels = source + row * work.sourceEdge;
    for (std::size_t x = 0; x < kScreenWidth; ++x) {
      screen[x] = pixels[columns[x]];
    }
  }
}

template <class T>
void EnterStretch(const StretchWork& work) {
  const auto screen = MakeSamples<T>(kScreenPixels);
  EnterLoop(
      work.work, [=] { Stretch(work, screen->data()); },
      [=] { return CheckStretch(work, screen->data()); });
  EnterMemset(work.work, kScreenPixels * sizeof(T));
}

}  // namespace

void EnterPlainImages() {
  EnterWindow();
  for (const ExtremesWork& work : ExtremesWorks()) {
    EnterExtremes(work);
  }
  for (const RescaleWork& work : RescaleWorks()) {
    if (work.bits == 8) {
      EnterRescale(work, Image8(kImageEdge));
    } else {
      EnterRescale(work, Image16());
    }
  }
  for (const StretchWork& work : StretchWorks()) {
    if (work.bytes == 1) {
      EnterStretch<std::uint8_t>(work);
    } else {
      EnterStretch<std::uint32_t>(work);
    }
  }
}

}  // namespace peers
