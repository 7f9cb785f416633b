#pragma once
// Forced into every source of the fuzz build when the compiler is clang 14: its libstdc++
// <source_location> needs a builtin that clang gained only in version 15, and leaves the
// type undefined. This stand-in gives the part the host uses (file, line, function).
#include <version>
#if defined(__clang__) && !defined(__cpp_lib_source_location)
#include <cstdint>
namespace std {
struct source_location {
  static constexpr source_location current(const char* file = __builtin_FILE(),
                                           const char* function = __builtin_FUNCTION(),
                                           uint_least32_t line = __builtin_LINE(),
                                           uint_least32_t column = __builtin_COLUMN()) noexcept {
    source_location at;
    at.file_ = file;
    at.function_ = function;
    at.line_ = line;
    at.column_ = column;
    return at;
  }
  constexpr const char* file_name() const noexcept { return file_; }
  constexpr const char* function_name() const noexcept { return function_; }
  constexpr uint_least32_t line() const noexcept { return line_; }
  constexpr uint_least32_t column() const noexcept { return column_; }

 private:
  const char* file_ = "";
  const char* function_ = "";
  uint_least32_t line_ = 0;
  uint_least32_t column_ = 0;
};
}  // namespace std
#endif
