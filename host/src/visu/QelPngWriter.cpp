#include "QelPngWriter.h"

#include <png.h>

#include <cerrno>
#include <csetjmp>
#include <cstdio>
#include <cstring>
#include <filesystem>

#include "QelPixelImage.h"

namespace {
struct Sink {
  std::FILE* file = nullptr;
  std::string* bytes = nullptr;
};

void WriteData(png_structp png, png_bytep data, png_size_t length) {
  auto* sink = static_cast<Sink*>(png_get_io_ptr(png));
  if (sink->bytes) {
    sink->bytes->append(reinterpret_cast<const char*>(data), length);
  } else if (std::fwrite(data, 1, length, sink->file) != length) {
    png_error(png, std::strerror(errno));
  }
}
void Flush(png_structp) {}

// libpng reports errors by longjmp; nothing with a destructor may live in this frame.
bool EncodeTo(const QelPixelImage& image, Sink& sink, char* message, size_t size) {
  png_structp png = png_create_write_struct(PNG_LIBPNG_VER_STRING, nullptr, nullptr, nullptr);
  png_infop info = png ? png_create_info_struct(png) : nullptr;
  if (!info) {
    png_destroy_write_struct(&png, nullptr);
    std::snprintf(message, size, "out of memory");
    return false;
  }
  if (setjmp(png_jmpbuf(png))) {
    std::snprintf(message, size, "could not encode the picture");
    png_destroy_write_struct(&png, &info);
    return false;
  }
  png_set_write_fn(png, &sink, WriteData, Flush);
  // Fast settings: a thumbnail is encoded on every preview and read rarely.
  png_set_compression_level(png, 1);
  png_set_compression_strategy(png, 3);  // Z_RLE: rows of flat colour and background dominate a thumbnail
  png_set_compression_mem_level(png, 9);
  png_set_compression_buffer_size(png, 1 << 17);
  png_set_filter(png, PNG_FILTER_TYPE_BASE, PNG_FILTER_UP);
  png_set_IHDR(png, info, image.GetWidth(), image.GetHeight(), 8, PNG_COLOR_TYPE_RGB, PNG_INTERLACE_NONE,
               PNG_COMPRESSION_TYPE_DEFAULT, PNG_FILTER_TYPE_DEFAULT);
  png_write_info(png, info);
  for (int y = 0; y < image.GetHeight(); ++y) png_write_row(png, const_cast<png_bytep>(image.Row(y)));
  png_write_end(png, nullptr);
  png_destroy_write_struct(&png, &info);
  return true;
}
}  // namespace

bool QelPngWriter::Encode(const QelPixelImage& image, std::string& bytes) {
  if (image.GetWidth() == 0) return false;
  bytes.clear();
  Sink sink{nullptr, &bytes};
  char message[256];
  return EncodeTo(image, sink, message, sizeof message);
}

bool QelPngWriter::Write(const QelPixelImage& image, const std::string& path, std::string& error) {
  if (image.GetWidth() == 0) {
    error = path + ": the picture is empty";
    return false;
  }
  const std::string temporary = path + ".part";
  Sink sink;
  sink.file = std::fopen(temporary.c_str(), "wb");
  if (!sink.file) {
    error = path + ": " + std::strerror(errno);
    return false;
  }
  char message[256] = "";
  bool ok = EncodeTo(image, sink, message, sizeof message);
  if (std::fclose(sink.file) != 0 && ok) {
    std::snprintf(message, sizeof message, "%s", std::strerror(errno));
    ok = false;
  }
  std::error_code ec;
  if (ok) std::filesystem::rename(temporary, path, ec);
  if (ok && ec) {
    std::snprintf(message, sizeof message, "%s", ec.message().c_str());
    ok = false;
  }
  if (!ok) {
    std::filesystem::remove(temporary, ec);
    error = path + ": " + message;
  }
  return ok;
}
