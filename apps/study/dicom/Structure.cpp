#include <dcmtk/config/osconfig.h>

#include <dcmtk/dcmdata/dctk.h>
#include <study/Error.h>
#include <study/dicom/FileWindow.h>
#include <study/dicom/Structure.h>

#include <algorithm>
#include <limits>
#include <optional>
#include <vector>

// The walk:
// 1. The meta header (group 0002, always explicit little endian) tells the transfer syntax.
// 2. A stack holds the open sequences and items with their ends. At each position stands an element
//    (in an item or the data set) or an item (in a sequence); its header tells what to open or
//    skip.
// 3. Anything that does not fit the rules makes the file "irregular". How the toolkit would read it
//    is anybody's guess, but it opens an item only where it meets an item tag: counting these tags
//    in all of the file bounds the depth.

namespace study {
namespace {

constexpr std::uint64_t kPreamble = 132;
constexpr std::uint32_t kUndefined = 0xFFFFFFFF;
constexpr std::uint32_t kItem = 0xFFFEE000;
constexpr std::uint32_t kItemEnd = 0xFFFEE00D;
constexpr std::uint32_t kSequenceEnd = 0xFFFEE0DD;
constexpr std::uint32_t kPixelData = 0x7FE00010;
constexpr std::uint32_t kTransferSyntax = 0x00020010;
constexpr std::uint32_t kMetaLength = 0x00020000;
constexpr std::size_t kHarmlessItems = 256;

/// How an element's header is read.
struct Coding {
  bool isExplicit = true;
  bool bigEndian = false;
};

/// Tag, value representation (two letters; empty without one), length and where the value begins.
struct ElementHeader {
  std::uint32_t tag = 0;
  std::string vr;
  std::uint32_t length = 0;
  std::uint64_t value = 0;
};

std::uint32_t Number(std::span<const std::uint8_t> bytes, bool bigEndian) {
  std::uint32_t number = 0;
  for (std::size_t i = 0; i < bytes.size(); ++i) {
    number |= std::uint32_t{bytes[bigEndian ? bytes.size() - 1 - i : i]} << (8 * i);
  }
  return number;
}

bool HasLongLength(const std::string& vr) {
  static const std::vector<std::string> kinds{"OB", "OD", "OF", "OL", "OV", "OW", "SQ",
                                              "SV", "UC", "UN", "UR", "UT", "UV"};
  return std::find(kinds.begin(), kinds.end(), vr) != kinds.end();
}

bool HasShortLength(const std::string& vr) {
  static const std::vector<std::string> kinds{"AE", "AS", "AT", "CS", "DA", "DS", "DT",
                                              "FL", "FD", "IS", "LO", "LT", "PN", "SH",
                                              "SL", "SS", "ST", "TM", "UI", "UL", "US"};
  return std::find(kinds.begin(), kinds.end(), vr) != kinds.end();
}

/// The header at `at`; empty when there is none.
std::optional<ElementHeader> ReadHeader(FileWindow& file, std::uint64_t at, const Coding& coding) {
  const auto start = file.At(at, 8);
  if (start.empty()) {
    return std::nullopt;
  }
  ElementHeader header;
  header.tag = Number(start.first(2), coding.bigEndian) << 16 |
               Number(start.subspan(2, 2), coding.bigEndian);
  header.length = Number(start.subspan(4, 4), coding.bigEndian);
  header.value = at + 8;
  if (header.tag >> 16 == 0xFFFE || !coding.isExplicit) {
    return header;
  }
  header.vr = {static_cast<char>(start[4]), static_cast<char>(start[5])};
  header.length = Number(start.subspan(6, 2), coding.bigEndian);
  if (HasShortLength(header.vr)) {
    return header;
  }
  const auto length = file.At(at + 8, 4);
  if (!HasLongLength(header.vr) || length.empty()) {
    return std::nullopt;
  }
  header.length = Number(length, coding.bigEndian);
  header.value = at + 12;
  return header;
}

/// Where the data set begins and how it is coded.
struct MetaHeader {
  std::uint64_t end = 0;
  std::string syntax;
};

/// Empty when the meta header is irregular.
std::optional<MetaHeader> ReadMetaHeader(FileWindow& file) {
  MetaHeader meta;
  std::optional<std::uint64_t> announced;
  meta.end = kPreamble;
  for (;;) {
    const auto group = file.At(meta.end, 2);
    if (group.empty() || Number(group, false) != 2) {
      break;
    }
    const auto header = ReadHeader(file, meta.end, {});
    if (!header || header->length > file.Size() - header->value) {
      return std::nullopt;
    }
    const auto value = header->length <= FileWindow::kLargestRead
                           ? file.At(header->value, header->length)
                           : std::span<const std::uint8_t>();
    meta.end = header->value + header->length;
    if (header->tag == kTransferSyntax) {
      meta.syntax.assign(value.begin(), value.end());
      meta.syntax.erase(meta.syntax.find_last_not_of(std::string(" \0", 2)) + 1);
    } else if (header->tag == kMetaLength && value.size() == 4) {
      announced = meta.end + Number(value, false);
    }
  }
  if (meta.syntax.empty() || (announced && *announced != meta.end)) {
    return std::nullopt;
  }
  return meta;
}

Coding CodingOf(const std::string& syntax) {
  return {syntax != UID_LittleEndianImplicitTransferSyntax,
          syntax == UID_BigEndianExplicitTransferSyntax};
}

bool IsSequenceInDictionary(std::uint32_t tag) {
  return DcmTag(static_cast<Uint16>(tag >> 16), static_cast<Uint16>(tag & 0xFFFF)).getEVR() ==
         EVR_SQ;
}

class Walk {
 public:
  Walk(FileWindow& file, std::uint64_t begin, const Coding& coding) : m_file(file), m_at(begin) {
    m_open.push_back({Level::Items, file.Size(), true, coding});
  }

  enum class Result { Regular, Irregular, TooDeep };

  Result Run() {
    while (!m_open.empty()) {
      if (m_open.back().hasEnd && m_at == m_open.back().limit) {
        m_open.pop_back();
      } else if (!Step()) {
        return Result::Irregular;
      } else if (m_open.size() > 2 * kDeepestNesting) {
        return Result::TooDeep;
      }
    }
    return Result::Regular;
  }

 private:
  struct Level {
    enum Kind { Items, Sequence, Fragments };  ///< `Items`: of elements, an item or the data set
    Kind kind;
    std::uint64_t limit;  ///< nothing inside reaches beyond it
    bool hasEnd;          ///< it ends there; else an end tag ends it
    Coding coding;
  };

  bool Step() {
    const Level top = m_open.back();
    const auto header = ReadHeader(m_file, m_at, top.coding);
    if (!header || header->value > top.limit) {
      return false;
    }
    if (header->length != kUndefined && header->length > top.limit - header->value) {
      return false;
    }
    m_at = header->value;
    if (top.kind == Level::Items) {
      return header->tag == kItemEnd ? Close(top, *header) : Element(top, *header);
    }
    return header->tag == kSequenceEnd ? Close(top, *header) : Item(top, *header);
  }

  bool Close(const Level& top, const ElementHeader& header) {
    m_open.pop_back();
    return !top.hasEnd && header.length == 0;
  }

  bool Item(const Level& top, const ElementHeader& header) {
    if (header.tag != kItem) {
      return false;
    }
    if (top.kind == Level::Sequence) {
      Open(Level::Items, header, top.coding);
      return true;
    }
    m_at += header.length;
    return header.length != kUndefined;
  }

  bool Element(const Level& top, const ElementHeader& header) {
    if (header.tag >> 16 == 0xFFFE) {
      return false;
    }
    const bool isUndefined = header.length == kUndefined;
    if (header.tag == kPixelData && isUndefined) {
      Open(Level::Fragments, header, top.coding);
    } else if (header.vr == "UN" && isUndefined) {
      Open(Level::Sequence, header, {false, false});  // its content is always coded so
    } else if (header.vr == "SQ" ||
               (header.vr.empty() && (isUndefined || IsSequenceInDictionary(header.tag)))) {
      Open(Level::Sequence, header, top.coding);
    } else {
      m_at += header.length;
      return !isUndefined;
    }
    return true;
  }

  void Open(Level::Kind kind, const ElementHeader& header, const Coding& coding) {
    const bool hasEnd = header.length != kUndefined;
    const std::uint64_t limit = hasEnd ? header.value + header.length : m_open.back().limit;
    m_open.push_back({kind, limit, hasEnd, coding});
  }

  FileWindow& m_file;
  std::uint64_t m_at;
  std::vector<Level> m_open;
};

/// How many item tags, of either byte order, stand anywhere in the file.
std::size_t CountItemTags(FileWindow& file) {
  std::size_t count = 0;
  for (std::uint64_t at = 0; at < file.Size(); at += FileWindow::kLargestRead - 3) {
    const auto bytes = file.At(at, static_cast<std::size_t>(std::min<std::uint64_t>(
                                       FileWindow::kLargestRead, file.Size() - at)));
    for (std::size_t i = 0; i + 4 <= bytes.size(); ++i) {
      const std::uint32_t little =
          Number(bytes.subspan(i, 2), false) << 16 | Number(bytes.subspan(i + 2, 2), false);
      const std::uint32_t big = Number(bytes.subspan(i, 4), true);
      count += little == kItem || big == kItem ? 1 : 0;
    }
  }
  return count;
}

}  // namespace

std::string CheckStructure(const std::filesystem::path& path) {
  FileWindow file(path);
  const auto meta = ReadMetaHeader(file);
  const bool isPlain = meta && meta->syntax != UID_DeflatedExplicitVRLittleEndianTransferSyntax;
  const auto result =
      isPlain ? Walk(file, meta->end, CodingOf(meta->syntax)).Run() : Walk::Result::Irregular;
  if (result == Walk::Result::TooDeep) {
    throw Error("the file is damaged (sequences within sequences without end)");
  }
  if (result == Walk::Result::Irregular && CountItemTags(file) > kHarmlessItems) {
    throw Error("the file is damaged (its structure is broken)");
  }
  return meta ? meta->syntax : std::string();
}

}  // namespace study
