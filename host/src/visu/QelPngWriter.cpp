#include "QelPngWriter.h"

#include <libdeflate.h>

#include <cerrno>
#include <cstdio>
#include <cstring>
#include <filesystem>
#include <memory>

#include "QelPixelImage.h"

namespace {
// A rendered picture is mostly flat colour and background: unfiltered rows at this level
// of libdeflate come within a few percent of libpng's default settings (adaptive filters,
// zlib level 6) in size, and encode faster than zlib's fastest level; row filters bought
// at most 7 % more for up to twice the time (docs/panel-speed.md).
constexpr int kLevel = 4;

void AppendBigEndian(std::string& out, uint32_t value) {
  const char bytes[4] = {char(value >> 24), char(value >> 16), char(value >> 8), char(value)};
  out.append(bytes, 4);
}

void AppendChunk(std::string& out, const char type[4], const void* data, size_t length) {
  AppendBigEndian(out, static_cast<uint32_t>(length));
  const size_t start = out.size();
  out.append(type, 4);
  out.append(static_cast<const char*>(data), length);
  AppendBigEndian(out, libdeflate_crc32(0, out.data() + start, length + 4));
}

struct CompressorDeleter {
  void operator()(libdeflate_compressor* c) const { libdeflate_free_compressor(c); }
};
}  // namespace

bool QelPngWriter::Encode(const QelPixelImage& image, std::string& bytes) {
  const int width = image.GetWidth(), height = image.GetHeight();
  if (width <= 0 || height <= 0) return false;
  // Each row is stored with filter type 0 (none) in front of it.
  const size_t stride = static_cast<size_t>(width) * 3;
  std::string rows(static_cast<size_t>(height) * (stride + 1), '\0');
  for (int y = 0; y < height; ++y) std::memcpy(&rows[static_cast<size_t>(y) * (stride + 1) + 1], image.Row(y), stride);

  thread_local std::unique_ptr<libdeflate_compressor, CompressorDeleter> compressor(
      libdeflate_alloc_compressor(kLevel));
  if (!compressor) return false;
  std::string compressed(libdeflate_zlib_compress_bound(compressor.get(), rows.size()), '\0');
  const size_t length =
      libdeflate_zlib_compress(compressor.get(), rows.data(), rows.size(), compressed.data(), compressed.size());
  if (length == 0) return false;

  bytes.clear();
  bytes.reserve(length + 64);
  bytes.append("\x89PNG\r\n\x1a\n", 8);
  std::string header;
  AppendBigEndian(header, static_cast<uint32_t>(width));
  AppendBigEndian(header, static_cast<uint32_t>(height));
  header.append("\x08\x02\x00\x00\x00", 5);  // 8 bits, RGB, deflate, adaptive filtering, no interlace
  AppendChunk(bytes, "IHDR", header.data(), header.size());
  AppendChunk(bytes, "IDAT", compressed.data(), length);
  AppendChunk(bytes, "IEND", nullptr, 0);
  return true;
}

bool QelPngWriter::Write(const QelPixelImage& image, const std::string& path, std::string& error) {
  std::string bytes;
  if (!Encode(image, bytes)) {
    error = path + ": the picture is empty";
    return false;
  }
  const std::string temporary = path + ".part";
  std::FILE* file = std::fopen(temporary.c_str(), "wb");
  if (!file) {
    error = path + ": " + std::strerror(errno);
    return false;
  }
  bool ok = std::fwrite(bytes.data(), 1, bytes.size(), file) == bytes.size();
  std::string reason = ok ? "" : std::strerror(errno);
  if (std::fclose(file) != 0 && ok) {
    reason = std::strerror(errno);
    ok = false;
  }
  std::error_code ec;
  if (ok) std::filesystem::rename(temporary, path, ec);
  if (ok && ec) {
    reason = ec.message();
    ok = false;
  }
  if (!ok) {
    std::filesystem::remove(temporary, ec);
    error = path + ": " + reason;
  }
  return ok;
}
