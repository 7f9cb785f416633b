#pragma once
// QelTextRenderer: sets short texts into a pixel image with FreeType, in one font at one
// pixel size. Built once per draw (or kept by a caller); holds the FreeType library and
// face and frees them with itself. Not copyable.
#include <memory>
#include <string>

#include "QelPixelImage.h"
#include "QelRenderScene.h"

class QelTextRenderer {
 public:
  // The font shipped by fonts-dejavu-core.
  static constexpr const char* kDefaultFont = "/usr/share/fonts/truetype/dejavu/DejaVuSans.ttf";

  // Use IsReady to learn whether the font could be opened; Error says why not.
  explicit QelTextRenderer(const std::string& fontPath = kDefaultFont, int pixelSize = 13);
  ~QelTextRenderer();
  QelTextRenderer(const QelTextRenderer&) = delete;
  QelTextRenderer& operator=(const QelTextRenderer&) = delete;

  bool IsReady() const;
  const std::string& Error() const { return error_; }
  // Width in pixels of `text` (UTF-8) and the line height.
  int Measure(const std::string& text) const;
  int LineHeight() const { return lineHeight_; }
  // Draws `text` with its top-left corner at (x, y), blended over the image.
  void Draw(QelPixelImage& image, int x, int y, const std::string& text, const QelRenderColor& color) const;

 private:
  struct Face;
  std::unique_ptr<Face> face_;
  std::string error_;
  int lineHeight_ = 0;
};
