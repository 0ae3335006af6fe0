// How a bitmap is saved, recognised in a file, and drawn into another.

#include <vorl/Data/dDIB.h>

#include <atomic>
#include <climits>
#include <cstdlib>
#include <cstring>
#include <new>

#include <vorl/Common/LogContext.h>
#include <vorl/Data/detail/BitmapFile.h>
#include <vorl/Platform/detail/File.h>
#include <vorl/Platform/detail/MemoryContext.h>
#include <vorl/Platform/detail/SystemError.h>

inline namespace vorl {

namespace {

constexpr DWORD kOldHeaderSize = 12;  // of a header whose width and height have 16 bits

/// The size that an information header states; false when it states none.
bool ReadSize(std::FILE* file, int& width, int& height) {
  // A palette entry more than the header is read; a file that ends before it has its size, too.
  unsigned char bytes[sizeof(tagBITMAPINFO)] = {};
  const std::size_t count = std::fread(bytes, 1, sizeof(bytes), file);
  tagBITMAPINFOHEADER header{};
  std::memcpy(&header, bytes, sizeof(header));
  if (header.biSize == kOldHeaderSize && count >= kOldHeaderSize) {
    WORD size[2];
    std::memcpy(size, bytes + 4, sizeof(size));
    width = size[0];
    height = size[1];
    return true;
  }
  if (count < sizeof(header) || header.biWidth < -INT_MAX || header.biHeight < -INT_MAX) {
    return false;
  }
  width = std::abs(header.biWidth);
  height = std::abs(header.biHeight);
  return true;
}

}  // namespace

HBITMAP dDIB::GetHandle() const {
  return m_handle;
}

tagBITMAPINFO* dDIB::GetHeader() const {
  return m_descriptor.GetHeader();
}

unsigned short dDIB::GetBitsPerPixel() const {
  const tagBITMAPINFO* const header = GetHeader();
  return header != nullptr ? header->bmiHeader.biBitCount : WORD{0};
}

unsigned short dDIB::GetPaletteSize() const {
  return m_descriptor.GetPaletteSize();
}

tagRGBQUAD* dDIB::GetPalette() const {
  return m_descriptor.GetPalette();
}

bool dDIB::ResetPalette(bool ascending) {
  return m_descriptor.ResetPalette(ascending);
}

void dDIB::SetFileName(const char* filePath) {
  try {
    m_fileName = filePath != nullptr ? filePath : "";
  } catch (const std::bad_alloc&) {
    m_fileName.clear();
  }
}

bool dDIB::Save(const char* filePath, bool overwrite) {
  LogContext context("dDIB::Save", __FILE__, __LINE__, true);
  if (!IsValid()) {
    m_status.Set(false, "dDIB::Save: image is not initialized");
    context.Status(__LINE__, m_status);
    return false;
  }
  char numberedName[32];
  if (filePath == nullptr && !m_fileName.empty()) {
    filePath = m_fileName.c_str();
  } else if (filePath == nullptr) {
    static std::atomic<int> count{0};
    std::snprintf(numberedName, sizeof(numberedName), "DIBImage%d.bmp", ++count);
    filePath = numberedName;
  }
  if (!m_descriptor.Save(filePath, overwrite)) {
    m_status.Set(m_descriptor.GetStatus(), "dDIB::Save: error:");
    context.Status(__LINE__, m_status);
    return false;
  }
  m_status = true;
  return true;
}

bool dDIB::IsBitmapFile(const char* filePath, int& width, int& height) {
  LogContext context("dDIB::IsBitmapFile", __FILE__, __LINE__, true);
  width = 0;
  height = 0;
  if (filePath == nullptr) {
    context.Error(__LINE__, "missing filename(NULL)");
    return false;
  }
  const vorl_detail::FileHandle file(vorl_detail::OpenFileForReading(filePath));
  if (file == nullptr) {
    context.Error(__LINE__, "can't open '%s'", filePath);
    return false;
  }
  tagBITMAPFILEHEADER header{};
  if (std::fread(&header, sizeof(header), 1, file.get()) == 1 &&
      header.bfType == vorl_detail::kBitmapFileType && ReadSize(file.get(), width, height)) {
    return true;
  }
  context.Info("'%s' is not a bitmap file", filePath);
  return false;
}

bool dDIB::DrawBits(const dDIB& source, int x, int y, DWORD rasterOperation) const {
  const vorl_detail::MemoryContext target(nullptr, m_handle);
  const vorl_detail::MemoryContext drawn(nullptr, source.m_handle);
  if (!target.HasBitmap()) {
    return false;
  }
  const int width = static_cast<int>(source.GetWidth());
  const int height = static_cast<int>(source.GetHeight());
  SetStretchBltMode(target.Get(), WHITEONBLACK);
  const int rows =
      StretchDIBits(target.Get(), x, y, width, height, 0, 0, width, height, source.GetDataPtr(),
                    source.GetHeader(), DIB_RGB_COLORS, rasterOperation);
  GdiFlush();
  return rows != 0;
}

bool dDIB::Combine(const dDIB& source, int x, int y, int rasterOperation) {
  LogContext context("dDIB::Combine", __FILE__, __LINE__, true);
  if (m_handle == nullptr) {
    m_status.Set(false, "Combine: missing target bitmap handle");
  } else if (source.m_handle == nullptr) {
    m_status.Set(false, "Combine: missing source bitmap handle");
  } else if (!DrawBits(source, x, y, static_cast<DWORD>(rasterOperation))) {
    m_status.Set(false, "Combine: BitBlt error:'%s'", vorl_detail::LastErrorText().c_str());
  } else {
    m_status = true;
    return true;
  }
  context.Status(__LINE__, m_status);
  return false;
}

}  // namespace vorl
