#include "QelTextRenderer.h"

#include <ft2build.h>
#include FT_FREETYPE_H

#include <algorithm>
#include <unordered_map>
#include <vector>

struct QelTextRenderer::Face {
  // A character's rendered coverage, kept: a picture of a large model sets thousands of
  // texts from a few dozen characters, and FreeType's hinting is the cost of each.
  struct Glyph {
    bool loaded = false;
    int left = 0, top = 0, advance = 0;
    unsigned width = 0, rows = 0;
    std::vector<uint8_t> coverage;  // rows x width
  };

  const Glyph& Get(char32_t code) {
    Glyph& glyph = glyphs[code];
    if (glyph.loaded || FT_Load_Char(face, code, FT_LOAD_RENDER) != 0) return glyph;
    const FT_GlyphSlot g = face->glyph;
    const FT_Bitmap& bm = g->bitmap;
    glyph = {true, g->bitmap_left, g->bitmap_top, static_cast<int>(g->advance.x >> 6), bm.width, bm.rows, {}};
    glyph.coverage.resize(size_t(bm.width) * bm.rows);
    for (unsigned row = 0; row < bm.rows; ++row)
      std::copy_n(bm.buffer + row * bm.pitch, bm.width, glyph.coverage.begin() + row * bm.width);
    return glyph;
  }

  FT_Library library = nullptr;
  FT_Face face = nullptr;
  std::unordered_map<char32_t, Glyph> glyphs;
  ~Face() {
    if (face) FT_Done_Face(face);
    if (library) FT_Done_FreeType(library);
  }
};

namespace {
// Decodes one UTF-8 character at `i`, moving past it; U+FFFD for a broken sequence.
char32_t NextChar(const std::string& s, size_t& i) {
  const auto c = static_cast<unsigned char>(s[i++]);
  if (c < 0x80) return c;
  int more = c >= 0xF0 ? 3 : c >= 0xE0 ? 2 : c >= 0xC0 ? 1 : -1;
  if (more < 0) return 0xFFFD;
  char32_t code = c & (0x3F >> more);
  for (; more > 0; --more) {
    if (i >= s.size() || (static_cast<unsigned char>(s[i]) & 0xC0) != 0x80) return 0xFFFD;
    code = (code << 6) | (static_cast<unsigned char>(s[i++]) & 0x3F);
  }
  return code;
}
}  // namespace

QelTextRenderer::QelTextRenderer(const std::string& fontPath, int pixelSize) : face_(std::make_unique<Face>()) {
  if (FT_Init_FreeType(&face_->library) != 0) {
    error_ = "the FreeType library could not be started";
    face_.reset();
    return;
  }
  if (FT_New_Face(face_->library, fontPath.c_str(), 0, &face_->face) != 0) {
    error_ = "cannot open the font " + fontPath + " (install the package fonts-dejavu-core)";
    face_.reset();
    return;
  }
  FT_Set_Pixel_Sizes(face_->face, 0, static_cast<FT_UInt>(pixelSize));
  lineHeight_ = static_cast<int>(face_->face->size->metrics.height >> 6);
}

QelTextRenderer::~QelTextRenderer() = default;

bool QelTextRenderer::IsReady() const { return face_ != nullptr; }

int QelTextRenderer::Measure(const std::string& text) const {
  if (!face_) return 0;
  int width = 0;
  for (size_t i = 0; i < text.size();) width += face_->Get(NextChar(text, i)).advance;
  return width;
}

void QelTextRenderer::Draw(QelPixelImage& image, int x, int y, const std::string& text,
                           const QelRenderColor& color) const {
  if (!face_) return;
  const int baseline = y + static_cast<int>(face_->face->size->metrics.ascender >> 6);
  const float ink[3] = {color.r * 255.0f, color.g * 255.0f, color.b * 255.0f};
  int pen = x;
  for (size_t i = 0; i < text.size();) {
    const Face::Glyph& g = face_->Get(NextChar(text, i));
    if (!g.loaded) continue;
    for (unsigned row = 0; row < g.rows; ++row) {
      for (unsigned col = 0; col < g.width; ++col) {
        const float alpha = g.coverage[row * g.width + col] / 255.0f;
        if (alpha == 0.0f) continue;
        const int px = pen + g.left + static_cast<int>(col);
        const int py = baseline - g.top + static_cast<int>(row);
        uint8_t r, gr, b;
        if (px < 0 || py < 0 || px >= image.GetWidth() || py >= image.GetHeight()) continue;
        image.GetPixel(px, py, r, gr, b);
        auto mix = [&](uint8_t under, float over) { return static_cast<uint8_t>(under + (over - under) * alpha + 0.5f); };
        image.SetPixel(px, py, mix(r, ink[0]), mix(gr, ink[1]), mix(b, ink[2]));
      }
    }
    pen += g.advance;
  }
}
