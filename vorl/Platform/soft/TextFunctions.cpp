#include <vorl/Platform/Gdi.h>
#include <vorl/Platform/soft/DeviceContext.h>
#include <vorl/Platform/soft/FontFace.h>
#include <vorl/Platform/soft/TextLayout.h>
#include <vorl/Platform/soft/TextPainter.h>
#include <vorl/Platform/soft/Utf8.h>

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <memory>
#include <string_view>
#include <vector>

namespace {

using vorl_detail::DeviceContext;
using vorl_detail::FontFace;
using vorl_detail::Region;
using vorl_detail::TextFormat;
using vorl_detail::TextLine;
using vorl_detail::TextRun;

int Saturated(std::int64_t value) {
  return static_cast<int>(std::clamp<std::int64_t>(value, INT32_MIN, INT32_MAX));
}

std::int64_t WidthOf(const RECT& rect) {
  return std::int64_t{rect.right} - rect.left;
}

// Half of a difference in whole pixels, downwards.
std::int64_t HalfBelow(std::int64_t value) {
  return value >= 0 ? value / 2 : -((1 - value) / 2);
}

// The laid out text and its place.
struct Block {
  std::vector<TextLine> lines;
  std::int64_t lineHeight;
  std::int64_t top;

  std::int64_t Bottom() const { return top + lineHeight * static_cast<std::int64_t>(lines.size()); }
  std::int64_t Width() const {
    std::int64_t width = 0;
    for (const TextLine& line : lines) {
      width = std::max(width, line.width);
    }
    return width;
  }
};

// Lines that would begin below a rectangle that clips are neither drawn nor counted.
void DropHiddenLines(Block& block, const RECT& rect, const TextFormat& format) {
  if ((format.flags & (DT_NOCLIP | DT_CALCRECT | DT_SINGLELINE)) != 0 || block.lineHeight <= 0) {
    return;
  }
  const std::int64_t height = std::int64_t{rect.bottom} - rect.top;
  const std::int64_t shown = height < 0 ? 1 : height / block.lineHeight + 1;
  if (shown < static_cast<std::int64_t>(block.lines.size())) {
    block.lines.resize(static_cast<std::size_t>(shown));
  }
}

Block LayOut(std::string_view text, FontFace& font, const RECT& rect, const TextFormat& format) {
  Block block{vorl_detail::LayOutText(vorl_detail::DecodeUtf8(text), font, format, WidthOf(rect)),
              font.Metrics().Height(), rect.top};
  if ((format.flags & DT_EXTERNALLEADING) != 0) {
    block.lineHeight += font.Metrics().externalLeading;
  }
  // Several lines start at the top whatever the format says.
  if ((format.flags & DT_SINGLELINE) != 0) {
    const std::int64_t height = std::int64_t{rect.bottom} - rect.top;
    if ((format.flags & DT_VCENTER) != 0) {
      block.top += height / 2 - block.lineHeight / 2;
    } else if ((format.flags & DT_BOTTOM) != 0) {
      block.top += height - block.lineHeight;
    }
  }
  DropHiddenLines(block, rect, format);
  return block;
}

std::int64_t LineStart(const TextLine& line, const RECT& rect, const TextFormat& format) {
  const std::int64_t room = WidthOf(rect) - line.width;
  if ((format.flags & DT_CENTER) != 0) {
    return rect.left + HalfBelow(room);
  }
  return rect.left + ((format.flags & DT_RIGHT) != 0 ? room : 0);
}

void Draw(const DeviceContext& dc, FontFace& font, const Block& block, const RECT& rect,
          const TextFormat& format) {
  Region clip(dc.Visible());
  if ((format.flags & DT_NOCLIP) == 0) {
    if (vorl_detail::IsEmpty(rect)) {
      return;
    }
    clip.Intersect(rect);
  }
  const vorl_detail::TextPainter painter(dc, font, std::move(clip));
  std::int64_t top = block.top;
  for (const TextLine& line : block.lines) {
    for (const TextRun& run : line.runs) {
      painter.Draw(run, LineStart(line, rect, format), top);
    }
    top += block.lineHeight;
  }
}

// An empty text has the height of a line but takes no room, unless it is a single line.
int DrawNothing(int lineHeight, RECT& rect, const TextFormat& format) {
  if ((format.flags & DT_CALCRECT) != 0) {
    rect.right = rect.left;
    rect.bottom = (format.flags & DT_SINGLELINE) != 0
                      ? Saturated(std::int64_t{rect.top} + lineHeight)
                      : rect.top;
  }
  return lineHeight;
}

int DrawInContext(const DeviceContext& dc, std::string_view text, RECT& rect,
                  const TextFormat& format) {
  const std::shared_ptr<FontFace> font = FontFace::Find(dc.state.font->description);
  if (text.empty()) {
    return DrawNothing(font->Metrics().Height(), rect, format);
  }
  const Block block = LayOut(text, *font, rect, format);
  const std::int64_t height = block.Bottom() - rect.top;
  if ((format.flags & DT_CALCRECT) != 0) {
    rect.right = Saturated(rect.left + block.Width());
    rect.bottom = Saturated(block.Bottom());
  } else {
    Draw(dc, *font, block, rect, format);
  }
  // 0 would mean failure.
  return height == 0 && block.lineHeight > 0 ? 1 : Saturated(height);
}

}  // namespace

int DrawTextA(HDC dc, LPCSTR text, int count, LPRECT rect, UINT format) {
  return vorl_detail::Guarded(0, [&] {
    const auto context = vorl_detail::Find<DeviceContext>(dc);
    if (!context) {
      return 0;
    }
    if (text == nullptr || rect == nullptr) {
      vorl_detail::SetError(ERROR_INVALID_PARAMETER);
      return 0;
    }
    if (count == 0) {
      return 0;
    }
    const std::size_t length = count < 0 ? std::strlen(text) : static_cast<std::size_t>(count);
    return DrawInContext(*context, std::string_view(text, length), *rect, TextFormat(format));
  });
}

HFONT CreateFontA(int height, int width, int escapement, int orientation, int weight, DWORD italic,
                  DWORD underline, DWORD strikeOut, DWORD charSet, DWORD outPrecision,
                  DWORD clipPrecision, DWORD quality, DWORD pitchAndFamily, LPCSTR face) {
  return vorl_detail::Guarded<HFONT>(nullptr, [&] {
    LOGFONTA description{};
    description.lfHeight = height;
    description.lfWidth = width;
    description.lfEscapement = escapement;
    description.lfOrientation = orientation;
    description.lfWeight = weight;
    description.lfItalic = static_cast<BYTE>(italic);
    description.lfUnderline = static_cast<BYTE>(underline);
    description.lfStrikeOut = static_cast<BYTE>(strikeOut);
    description.lfCharSet = static_cast<BYTE>(charSet);
    description.lfOutPrecision = static_cast<BYTE>(outPrecision);
    description.lfClipPrecision = static_cast<BYTE>(clipPrecision);
    description.lfQuality = static_cast<BYTE>(quality);
    description.lfPitchAndFamily = static_cast<BYTE>(pitchAndFamily);
    if (face != nullptr) {
      std::strncpy(description.lfFaceName, face, LF_FACESIZE - 1);
    }
    return vorl_detail::Enter<HFONT>(std::make_shared<vorl_detail::Font>(description));
  });
}
