#pragma once
// QelPngWriter: writes a pixel image as a PNG file (fast compression: thumbnails are
// written often and read rarely). The file is written to a temporary name and renamed,
// so a failed write never leaves half a picture under the final name.
#include <string>

class QelPixelImage;

namespace QelPngWriter {
// True on success; otherwise `error` names the file and the reason.
bool Write(const QelPixelImage& image, const std::string& path, std::string& error);
// The PNG bytes in memory (the benchmark measures encoding without a disk).
bool Encode(const QelPixelImage& image, std::string& bytes);
}  // namespace QelPngWriter
