#include <study/dicom/FileWindow.h>

#include <algorithm>
#include <system_error>

namespace study {

FileWindow::FileWindow(const std::filesystem::path& path) : m_file(path, std::ios::binary) {
  std::error_code error;
  const std::uintmax_t size = std::filesystem::file_size(path, error);
  m_size = error || !m_file ? 0 : size;
}

std::span<const std::uint8_t> FileWindow::At(std::uint64_t offset, std::size_t count) {
  if (count > kLargestRead || offset > m_size || m_size - offset < count) {
    return {};
  }
  const bool inside = offset >= m_begin && offset + count <= m_begin + m_bytes.size();
  if (!inside) {
    m_begin = offset;
    m_bytes.resize(static_cast<std::size_t>(std::min<std::uint64_t>(kWindow, m_size - offset)));
    m_file.clear();
    m_file.seekg(static_cast<std::streamoff>(offset));
    m_file.read(m_bytes.data(), static_cast<std::streamsize>(m_bytes.size()));
    m_bytes.resize(static_cast<std::size_t>(m_file.gcount()));
    if (m_bytes.size() < count) {
      return {};
    }
  }
  const auto* bytes = reinterpret_cast<const std::uint8_t*>(m_bytes.data());
  return {bytes + (offset - m_begin), count};
}

}  // namespace study
