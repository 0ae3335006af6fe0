// OpenCV: images that refer to the test data, and results in memory that is there before.
#include <memory>
#include <opencv2/core.hpp>
#include <opencv2/imgcodecs.hpp>
#include <opencv2/imgproc.hpp>
#include <vector>

#include "../ScratchFile.h"
#include "Checks.h"
#include "Contest.h"
#include "Works.h"

namespace peers {
namespace {

constexpr char kName[] = "OpenCV";

/// An image over pixels that are only read.
cv::Mat Over(const void* pixels, int width, int height, int type) {
  return {height, width, type, const_cast<void*>(pixels)};
}

void EnterWindow() {
  const WindowWork& work = TheWindow();
  Enter(work.work, kName, [work] {
    const cv::Mat source = Over(Image16().data(), kImageEdge, kImageEdge, CV_16U);
    cv::Mat levels(source.size(), CV_8U);
    const double scale = 255.0 / work.width;
    const double shift = -(work.centre - 0.5 * work.width) * scale;
    return Contender{[=] {
                       source.convertTo(levels, CV_8U, scale, shift);
                       return true;
                     },
                     [=] { return CheckWindow(levels.data); }};
  });
}

void EnterExtremes(const ExtremesWork& work) {
  Enter(work.work, kName, [work] {
    struct Extremes {
      double lowest;
      double highest;
    };
    const auto found = std::make_shared<Extremes>();
    const cv::Mat source = Over(work.samples().data(), work.width, work.height, CV_16U);
    return Contender{[=] {
                       cv::minMaxIdx(source, &found->lowest, &found->highest);
                       return true;
                     },
                     [=] { return CheckExtremes(work, found->lowest, found->highest); }};
  });
}

void EnterRescale(const RescaleWork& work) {
  Enter(work.work, kName, [work] {
    const bool isByte = work.bits == 8;
    const int type = isByte ? CV_8U : CV_16U;
    const void* const pixels =
        isByte ? static_cast<const void*>(Image8(kImageEdge).data()) : Image16().data();
    const cv::Mat source = Over(pixels, kImageEdge, kImageEdge, type);
    cv::Mat target(source.size(), type);
    return Contender{[=] {
                       source.convertTo(target, type, work.scale, work.shift);
                       return true;
                     },
                     [=] { return CheckRescale(work, target.data); }};
  });
}

// There is no projection of a volume: the slices are folded into one by hand; each slice's rows are
// reduced into one; the rows of the volume, as one tall image, are reduced to their maxima.
void EnterDepth(const DepthWork& work) {
  Enter(work.work, kName, [work] {
    std::vector<cv::Mat> slices;
    for (int z = 0; z < kDepth; ++z) {
      slices.push_back(
          Over(&Volume()[static_cast<std::size_t>(z) * kSliceVoxels], kWidth, kHeight, CV_16U));
    }
    const cv::Mat rows = Over(Volume().data(), kWidth, kHeight * kDepth, CV_16U);
    const DepthSize size = SizeOf(work);
    cv::Mat picture(size.height, size.width, CV_16U);
    const std::function<void()> project[3] = {
        [=] {
          cv::Mat column = picture.reshape(1, kHeight * kDepth);
          cv::reduce(rows, column, 1, cv::REDUCE_MAX);
        },
        [=] {
          for (int z = 0; z < kDepth; ++z) {
            cv::Mat row = picture.row(z);
            cv::reduce(slices[static_cast<std::size_t>(z)], row, 0, cv::REDUCE_MAX);
          }
        },
        [=] {
          cv::Mat sum = picture;
          cv::max(slices[0], slices[1], sum);
          for (std::size_t z = 2; z < slices.size(); ++z) {
            cv::max(sum, slices[z], sum);
          }
        }};
    return Contender{[=, run = project[work.axis]] {
                       run();
                       return true;
                     },
                     [=] { return CheckDepth(work, picture.ptr<std::uint16_t>()); }};
  });
}

void EnterStretch(const StretchWork& work) {
  Enter(work.work, kName, [work] {
    const int type = work.bytes == 1 ? CV_8U : CV_8UC4;
    const cv::Mat source = Over(SourceOf(work), work.sourceEdge, work.sourceEdge, type);
    cv::Mat screen(kScreenHeight, kScreenWidth, type);
    return Contender{[=] {
                       cv::resize(source, screen, screen.size(), 0, 0, cv::INTER_NEAREST);
                       return true;
                     },
                     [=] { return CheckStretch(work, screen.data); }};
  });
}

Contender SaveBitmap() {
  const auto file = std::make_shared<bench::ScratchFile>(".bmp");
  const cv::Mat image = Over(Image24().data(), kImageEdge, kImageEdge, CV_8UC3);
  return {[=] { return cv::imwrite(file->Name(), image); },
          [=] { return CheckBitmapFile(file->Name()); }};
}

Contender LoadBitmap() {
  const auto file = std::make_shared<bench::ScratchFile>(".bmp");
  const auto image = std::make_shared<cv::Mat>();
  cv::imwrite(file->Name(), Over(Image24().data(), kImageEdge, kImageEdge, CV_8UC3));
  return {[=] {
            *image = cv::imread(file->Name(), cv::IMREAD_COLOR);
            return !image->empty();
          },
          [=] { return CheckBitmap(image->data); }};
}

}  // namespace

void EnterOpenCv() {
  cv::setNumThreads(1);
  EnterWindow();
  for (const ExtremesWork& work : ExtremesWorks()) {
    EnterExtremes(work);
  }
  for (const RescaleWork& work : RescaleWorks()) {
    EnterRescale(work);
  }
  for (const DepthWork& work : DepthWorks()) {
    EnterDepth(work);
  }
  for (const StretchWork& work : StretchWorks()) {
    EnterStretch(work);
  }
  Enter(BitmapSaving(), kName, SaveBitmap);
  Enter(BitmapLoading(), kName, LoadBitmap);
}

}  // namespace peers
