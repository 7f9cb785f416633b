// The review server's header readers: the input is one header value, read as a Cookie
// header, an Origin and a Content-Length. None throws or crashes; a cookie value found is a
// piece of the header; an origin is accepted only in its two exact forms; a length is
// accepted only as plain digits and read back as the same number.
#include <charconv>

#include "QelFuzzTarget.h"
#include "QelHostWebRequest.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  const std::string_view header(reinterpret_cast<const char*>(data), size);

  for (const std::string& value : QelHostWebRequest::CookieValues(header, "qeltoken"))
    QelFuzzCheck(header.find("qeltoken=" + value) != std::string_view::npos, "a cookie value comes from the header");

  if (QelHostWebRequest::IsOwnOrigin(header, 8080))
    QelFuzzCheck(header == "http://127.0.0.1:8080" || header == "http://localhost:8080", "only the server's origin");

  if (const auto length = QelHostWebRequest::ParseContentLength(header)) {
    QelFuzzCheck(header.find_first_not_of("0123456789") == std::string_view::npos, "a length is digits only");
    size_t back = 0;
    const auto [end, error] = std::from_chars(header.data(), header.data() + header.size(), back);
    QelFuzzCheck(error == std::errc() && end == header.data() + header.size() && back == *length,
                 "a length reads as the number it states");
  }
  return 0;
}
