#pragma once
// Interface identifiers. They are written as the usual braced GUID text and parsed at
// compile time, so a mistyped identifier fails the build instead of a query at run time.
#include <array>
#include <cstdint>
#include <optional>
#include <stdexcept>
#include <string>
#include <string_view>

struct QelIID {
  uint32_t data1 = 0;
  uint16_t data2 = 0;
  uint16_t data3 = 0;
  std::array<uint8_t, 8> data4{};

  // Written out: queries compare identifiers on every call, and the defaulted form calls
  // memcmp for the last eight bytes where two identifiers nearly always differ in the first.
  friend constexpr bool operator==(const QelIID& a, const QelIID& b) {
    if (a.data1 != b.data1 || a.data2 != b.data2 || a.data3 != b.data3) return false;
    for (std::size_t i = 0; i < a.data4.size(); ++i)
      if (a.data4[i] != b.data4[i]) return false;
    return true;
  }
  friend constexpr bool operator<(const QelIID& a, const QelIID& b) {
    if (a.data1 != b.data1) return a.data1 < b.data1;
    if (a.data2 != b.data2) return a.data2 < b.data2;
    if (a.data3 != b.data3) return a.data3 < b.data3;
    return a.data4 < b.data4;
  }

  // Parses "{XXXXXXXX-XXXX-XXXX-XXXX-XXXXXXXXXXXX}" (hex digits in either case). In a
  // constant expression a malformed text is a compile error; at run time use TryParse.
  static constexpr QelIID Parse(std::string_view text) {
    auto parsed = TryParse(text);
    if (!parsed) throw std::invalid_argument("malformed interface identifier");
    return *parsed;
  }

  static constexpr std::optional<QelIID> TryParse(std::string_view t) {
    if (t.size() != 38 || t.front() != '{' || t.back() != '}') return std::nullopt;
    if (t[9] != '-' || t[14] != '-' || t[19] != '-' || t[24] != '-') return std::nullopt;
    uint8_t bytes[16] = {};
    int n = 0;
    for (size_t i = 1; i + 1 < t.size(); ++i) {
      if (i == 9 || i == 14 || i == 19 || i == 24) continue;
      int hi = Hex(t[i]);
      int lo = Hex(t[++i]);
      if (hi < 0 || lo < 0) return std::nullopt;
      bytes[n++] = static_cast<uint8_t>(hi * 16 + lo);
    }
    QelIID id;
    id.data1 = (uint32_t{bytes[0]} << 24) | (uint32_t{bytes[1]} << 16) | (uint32_t{bytes[2]} << 8) | bytes[3];
    id.data2 = static_cast<uint16_t>((bytes[4] << 8) | bytes[5]);
    id.data3 = static_cast<uint16_t>((bytes[6] << 8) | bytes[7]);
    for (int i = 0; i < 8; ++i) id.data4[i] = bytes[8 + i];
    return id;
  }

  // Upper-case braced text, the inverse of Parse.
  std::string ToString() const;

 private:
  static constexpr int Hex(char c) {
    if (c >= '0' && c <= '9') return c - '0';
    if (c >= 'a' && c <= 'f') return c - 'a' + 10;
    if (c >= 'A' && c <= 'F') return c - 'A' + 10;
    return -1;
  }
};
