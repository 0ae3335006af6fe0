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

// Of several ampersands in a line the last one counts.
const Character* LastUnderlined(Characters characters) {
  const Character* last = nullptr;
  for (const Character& character : characters) {
    last = character.isUnderlined ? &character : last;
  }
  return last;
}

// Places characters one after the other and measures them on the way.
class Ruler {
 public:
  Ruler(FontFace& font, const TextFormat& format)
      : m_font(font),
        m_expandsTabs((format.flags & DT_EXPANDTABS) != 0),
        m_tabStop(std::max(1, format.tabCharacters * font.Metrics().averageWidth)) {}

  bool IsTab(const Character& character) const { return m_expandsTabs && character.code == U'\t'; }

  TextLine Place(Characters characters) const {
    TextLine line;
    bool startsRun = true;
    const Character* const underlined = LastUnderlined(characters);
    for (const Character& character : characters) {
      if (IsTab(character)) {
        line.width = NextTabStop(line.width);
        startsRun = true;
        continue;
      }
      if (startsRun) {
        line.runs.push_back({line.width, 0, {}});
        startsRun = false;
      }
      TextRun& run = line.runs.back();
      const int advance = m_font.GlyphOf(character.code)->advance;
      run.characters.push_back({character.code, line.width, advance, &character == underlined});
      run.width += advance;
      line.width += advance;
    }
    return line;
  }

  // The place of the first character that goes beyond a width. Tabs may.
  std::size_t FirstBeyond(Characters characters, std::int64_t limit) const {
    std::int64_t width = 0;
    for (std::size_t i = 0; i < characters.size(); ++i) {
      if (IsTab(characters[i])) {
        width = NextTabStop(width);
        continue;
      }
      width += m_font.GlyphOf(characters[i].code)->advance;
      if (width > limit) {
        return i;
      }
    }
    return characters.size();
  }

 private:
  std::int64_t NextTabStop(std::int64_t x) const { return (x / m_tabStop + 1) * m_tabStop; }

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
  return IsSpace(before) ||
         (isHyphen && place < paragraph.size() && IsWordCharacter(paragraph[place].code));
}

struct Wrap {
  std::size_t end;   // of the line
  std::size_t next;  // where the next one starts
};

// Where the first line of a paragraph that does not fit ends: the character at `overflow` is the
// first one that does not. Only what stands behind the last expanded tab can be broken.
Wrap FirstLine(Characters paragraph, std::size_t overflow, const Ruler& ruler, bool isLeftAligned) {
  std::size_t end = overflow;
  while (end > 0 && !ruler.IsTab(paragraph[end - 1]) && !IsBreak(paragraph, end)) {
    --end;
  }
  if (end == 0 || ruler.IsTab(paragraph[end - 1])) {  // the first word alone is too wide
    end = overflow;
    while (end < paragraph.size() &&
           (ruler.IsTab(paragraph[end]) || !IsSpace(paragraph[end].code))) {
      ++end;
    }
    if (end < paragraph.size() && paragraph[end].code == U'\t') {
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
    const std::size_t overflow = ruler.FirstBeyond(paragraph, limit);
    if (overflow == paragraph.size()) {
      lines.push_back(ruler.Place(paragraph));
      return;
    }
    const Wrap wrap = FirstLine(paragraph, overflow, ruler, isLeftAligned);
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

std::vector<TextLine> LayOutText(const std::u32string& text, FontFace& font,
                                 const TextFormat& format, std::int64_t limit) {
  const std::vector<Character> characters =
      WithoutPrefixes(text, (format.flags & DT_NOPREFIX) == 0);
  const Ruler ruler(font, format);
  if ((format.flags & DT_SINGLELINE) != 0) {
    return {ruler.Place(characters)};
  }
  const bool isLeftAligned = (format.flags & (DT_CENTER | DT_RIGHT)) == 0;
  const bool wraps = (format.flags & DT_WORDBREAK) != 0 && limit >= 0;
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
