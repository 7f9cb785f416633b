#pragma once
// QelPixelImage: a counted picture in memory, rows top to bottom. Whoever creates one owns
// its first reference; an off-screen support draws into it, the PNG writer reads it.
#include <cstdint>
#include <vector>

#include "QelVar.h"

// The pixel layouts a QelPixelImage can hold; the numbers are stored values.
enum class QelPixelImageFormat : int {
  RGB = 2,  // 8-bit red, green, blue
};

class QelPixelImage : public QelBaseUnknown {
 public:
  // A black image; an unknown format or a negative size gives an empty one (0 x 0).
  QelPixelImage(int width, int height, int format = static_cast<int>(QelPixelImageFormat::RGB));

  int GetWidth() const { return width_; }
  int GetHeight() const { return height_; }
  int GetFormat() const { return format_; }
  int GetBytesPerPixel() const { return 3; }
  uint8_t* GetPixels() { return pixels_.data(); }
  const uint8_t* GetPixels() const { return pixels_.data(); }
  const uint8_t* Row(int y) const { return pixels_.data() + static_cast<size_t>(y) * width_ * 3; }
  void SetPixel(int x, int y, uint8_t r, uint8_t g, uint8_t b);
  void GetPixel(int x, int y, uint8_t& r, uint8_t& g, uint8_t& b) const;

 protected:
  ~QelPixelImage() override = default;

 private:
  int width_ = 0;
  int height_ = 0;
  int format_;
  std::vector<uint8_t> pixels_;
};
