#include <vorl/Platform/soft/TextLayout.h>

#include <algorithm>
#include <span>

inline namespace vorl {
namespace vorl_detail {

namespace {

struct Character {
  char32_t code;
  bool isUnderlined;
};
using Characters = std::span<const Character>;

bool EndsLine(char32_t code) {
  return code == U'\n' || code == U'\r';
}

// Resolves the ampersands. One at the end of the text stands for itself.
std::vector<Character> WithoutPrefixes(const std::u32string& text, bool hasPrefixes) {
  std::vector<Character> characters;
  characters.reserve(text.size());
  for (std::size_t i = 0; i < text.size(); ++i) {
    const bool isPrefix = hasPrefixes && text[i] == U'&' && i + 1 < text.size();
    if (isPrefix) {
      ++i;
    }
    characters.push_back({text[i], isPrefix && text[i] != U'&'});
  }
  return characters;
}

// Places characters one after the other and measures them on the way.
class Ruler {
 public:
  Ruler(FontFace& font, UINT format) : m_font(font), m_expandsTabs((format & DT_EXPANDTABS) != 0) {
    const std::int64_t characters = (format & DT_TABSTOP) != 0 ? (format >> 8U) & 0xFFU : 8;
    m_tabStop = std::max<std::int64_t>(1, characters * font.Metrics().averageWidth);
  }

  TextLine Place(Characters characters) const {
    TextLine line;
    bool startsRun = true;
    for (const Character& character : characters) {
      if (IsTab(character)) {
        line.width = (line.width / m_tabStop + 1) * m_tabStop;
        startsRun = true;
        continue;
      }
      if (startsRun) {
        line.runs.push_back({line.width, 0, {}});
        startsRun = false;
      }
      TextRun& run = line.runs.back();
      const int advance = m_font.GlyphOf(character.code).advance;
      run.characters.push_back({character.code, line.width, advance, character.isUnderlined});
      run.width += advance;
      line.width += advance;
    }
    return line;
  }

  // How many characters fit into a width.
  std::size_t Fitting(Characters characters, std::int64_t limit) const {
    std::int64_t width = 0;
    for (std::size_t i = 0; i < characters.size(); ++i) {
      width = IsTab(characters[i]) ? (width / m_tabStop + 1) * m_tabStop
                                   : width + m_font.GlyphOf(characters[i].code).advance;
      if (width > limit) {
        return i;
      }
    }
    return characters.size();
  }

 private:
  bool IsTab(const Character& character) const { return m_expandsTabs && character.code == U'\t'; }

  FontFace& m_font;
  bool m_expandsTabs;
  std::int64_t m_tabStop;
};

bool IsSpace(char32_t code) {
  return code == U' ' || code == U'\t';
}

bool IsWordCharacter(char32_t code) {
  return code >= 0x80 || (code >= U'0' && code <= U'9') || (code >= U'A' && code <= U'Z') ||
         (code >= U'a' && code <= U'z');
}

// May a line end between the characters before and behind the given place?
bool IsBreak(Characters paragraph, std::size_t place) {
  const char32_t before = paragraph[place - 1].code;
  const bool isHyphen = before == U'-' || before == U'/' || before == U'!' || before == U'?';
  return IsSpace(before) || (isHyphen && place > 1 && place < paragraph.size() &&
                             IsWordCharacter(paragraph[place].code));
}

struct Wrap {
  std::size_t end;   // of the line
  std::size_t next;  // where the next one starts
};

// Where the first line of a paragraph that does not fit ends: `fitting` characters of it fit.
Wrap FirstLine(Characters paragraph, std::size_t fitting, bool isLeftAligned) {
  std::size_t end = fitting;
  while (end > 0 && !IsBreak(paragraph, end)) {
    --end;
  }
  if (end == 0) {  // the first word alone is too wide
    end = fitting;
    while (end < paragraph.size() && !IsSpace(paragraph[end].code)) {
      ++end;
    }
  }
  if (end < paragraph.size() && paragraph[end].code == U' ') {
    return {end, end + 1};
  }
  const bool dropsSpace = !isLeftAligned && end > 0 && paragraph[end - 1].code == U' ';
  return {dropsSpace ? end - 1 : end, end};
}

// A paragraph has at least one line.
void AppendWrapped(std::vector<TextLine>& lines, Characters paragraph, const Ruler& ruler,
                   std::int64_t limit, bool isLeftAligned) {
  for (;;) {
    const std::size_t fitting = ruler.Fitting(paragraph, limit);
    if (fitting == paragraph.size()) {
      lines.push_back(ruler.Place(paragraph));
      return;
    }
    const Wrap wrap = FirstLine(paragraph, fitting, isLeftAligned);
    if (wrap.next == paragraph.size() && wrap.end == wrap.next) {
      lines.push_back(ruler.Place(paragraph));
      return;
    }
    lines.push_back(ruler.Place(paragraph.first(wrap.end)));
    paragraph = paragraph.subspan(wrap.next);
  }
}

// Takes the characters of a paragraph and the end of line behind it from the text.
Characters TakeParagraph(Characters& text) {
  const auto end = static_cast<std::size_t>(
      std::find_if(text.begin(), text.end(),
                   [](const Character& character) { return EndsLine(character.code); }) -
      text.begin());
  const Characters paragraph = text.first(end);
  std::size_t next = end;
  if (next < text.size()) {
    ++next;
    const bool isPair =
        next < text.size() && EndsLine(text[next].code) && text[next].code != text[end].code;
    next += isPair ? 1 : 0;
  }
  text = text.subspan(next);
  return paragraph;
}

}  // namespace

std::vector<TextLine> LayOutText(const std::u32string& text, FontFace& font, UINT format,
                                 std::int64_t limit) {
  const std::vector<Character> characters = WithoutPrefixes(text, (format & DT_NOPREFIX) == 0);
  const Ruler ruler(font, format);
  if ((format & DT_SINGLELINE) != 0) {
    return {ruler.Place(characters)};
  }
  const bool isLeftAligned = (format & (DT_CENTER | DT_RIGHT)) == 0;
  const bool wraps = (format & DT_WORDBREAK) != 0 && limit >= 0;
  std::vector<TextLine> lines;
  Characters rest = characters;
  while (!rest.empty()) {
    const Characters paragraph = TakeParagraph(rest);
    if (wraps) {
      AppendWrapped(lines, paragraph, ruler, limit, isLeftAligned);
    } else {
      lines.push_back(ruler.Place(paragraph));
    }
  }
  return lines;
}

}  // namespace vorl_detail
}  // namespace vorl
