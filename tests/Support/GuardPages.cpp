#include <tests/Support/GuardPages.h>

#include <cstring>
#include <new>

#if defined(_WIN32)
#include <windows.h>
#else
#include <sys/mman.h>
#include <unistd.h>
#endif

namespace {

#if defined(_WIN32)

std::size_t PageSize() {
  SYSTEM_INFO info;
  GetSystemInfo(&info);
  return info.dwPageSize;
}

void* ReservePages(std::size_t size) {
  return VirtualAlloc(nullptr, size, MEM_RESERVE, PAGE_NOACCESS);
}

bool OpenPages(void* pages, std::size_t size) {
  return VirtualAlloc(pages, size, MEM_COMMIT, PAGE_READWRITE) != nullptr;
}

void ReleasePages(void* pages, std::size_t) {
  VirtualFree(pages, 0, MEM_RELEASE);
}

#else

std::size_t PageSize() {
  return static_cast<std::size_t>(sysconf(_SC_PAGESIZE));
}

void* ReservePages(std::size_t size) {
  void* const pages = mmap(nullptr, size, PROT_NONE, MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
  return pages != MAP_FAILED ? pages : nullptr;
}

bool OpenPages(void* pages, std::size_t size) {
  return mprotect(pages, size, PROT_READ | PROT_WRITE) == 0;
}

void ReleasePages(void* pages, std::size_t size) {
  munmap(pages, size);
}

#endif

}  // namespace

GuardPages::GuardPages(std::size_t size, Side side) {
  static const std::size_t page = PageSize();
  const std::size_t open = size / page * page + page;  // one at least, for an empty block too
  m_pagesSize = open + 2 * page;
  m_pages = static_cast<unsigned char*>(ReservePages(m_pagesSize));
  if (m_pages == nullptr) {
    throw std::bad_alloc();
  }
  unsigned char* const first = m_pages + page;
  if (!OpenPages(first, open)) {
    ReleasePages(m_pages, m_pagesSize);
    throw std::bad_alloc();
  }
  std::memset(first, kFilling, open);
  m_data = side == Side::Before ? first : first + open - size;
}

GuardPages::~GuardPages() {
  ReleasePages(m_pages, m_pagesSize);
}
