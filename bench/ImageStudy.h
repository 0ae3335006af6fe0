#ifndef BENCH_IMAGESTUDY_H
#define BENCH_IMAGESTUDY_H

#include <vorl/Data/dImage.h>
#include <vorl/IO/BinaryDataIO.h>

#include <cstddef>
#include <vector>

namespace bench {

/// Images that are written to, and read from, one binary data file.
class ImageStudy : public IBinaryDataIO {
 public:
  explicit ImageStudy(std::size_t count) : m_images(count) {}

  void Write(BinaryDataOut& out) override {
    for (dImage& image : m_images) {
      out.Write(&image);
    }
  }
  void Read(BinaryDataIn& in) override {
    for (dImage& image : m_images) {
      in.Read(&image);
    }
  }

  std::vector<dImage>& Images() { return m_images; }
  const std::vector<dImage>& Images() const { return m_images; }

 private:
  std::vector<dImage> m_images;
};

}  // namespace bench

#endif
