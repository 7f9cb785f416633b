#include "QelPixelImage.h"

QelPixelImage::QelPixelImage(int width, int height, int format) : format_(format) {
  if (format != static_cast<int>(QelPixelImageFormat::RGB) || width <= 0 || height <= 0) return;
  width_ = width;
  height_ = height;
  pixels_.assign(static_cast<size_t>(width) * height * 3, 0);
}

void QelPixelImage::SetPixel(int x, int y, uint8_t r, uint8_t g, uint8_t b) {
  if (x < 0 || y < 0 || x >= width_ || y >= height_) return;
  uint8_t* p = pixels_.data() + (static_cast<size_t>(y) * width_ + x) * 3;
  p[0] = r;
  p[1] = g;
  p[2] = b;
}

void QelPixelImage::GetPixel(int x, int y, uint8_t& r, uint8_t& g, uint8_t& b) const {
  r = g = b = 0;
  if (x < 0 || y < 0 || x >= width_ || y >= height_) return;
  const uint8_t* p = pixels_.data() + (static_cast<size_t>(y) * width_ + x) * 3;
  r = p[0];
  g = p[1];
  b = p[2];
}
