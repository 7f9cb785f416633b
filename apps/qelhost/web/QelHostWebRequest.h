#pragma once
// QelHostWebRequest: the JSON bodies the review page posts, read into plain values. Pure
// parsing, no host object touched, so any thread may call it and the fuzz target can
// drive it alone. Every refusal is one line a person can act on.
#include <optional>
#include <string>
#include <string_view>
#include <vector>

struct QelHostWebEvent {
  enum class Type { Click, Text, Select, Expand, Collapse, Scroll };
  std::string id;  // a widget id of the panel's JSON ("0.3.1")
  Type type = Type::Click;
  std::string text;  // Text
  int index = 0;     // Select
  int x = 0, y = 0;  // Scroll
};

struct QelHostWebCamera {
  enum class Kind { Orbit, Zoom, Reframe };
  Kind kind = Kind::Reframe;
  double dx = 0.0, dy = 0.0;  // Orbit, in degrees
  double factor = 1.0;        // Zoom: > 1 comes closer
};

namespace QelHostWebRequest {
// Larger bodies are refused before they are read.
inline constexpr size_t kMaxBody = 65536;

bool ParseEvent(std::string_view body, QelHostWebEvent& event, std::string& error);
// `yes` true for "yes", false for "no".
bool ParseAnswer(std::string_view body, bool& yes, std::string& error);
bool ParseCamera(std::string_view body, QelHostWebCamera& camera, std::string& error);
bool ParseActivate(std::string_view body, int& item, std::string& error);

// Every value of the cookie `name` in a Cookie header, in order: a browser sends one per
// path and domain that matches, and an old server's may come first.
std::vector<std::string> CookieValues(std::string_view header, std::string_view name);
// True when `origin` (an Origin header) is this server's own page: http://127.0.0.1:PORT or
// http://localhost:PORT. "null" and every other origin are foreign.
bool IsOwnOrigin(std::string_view origin, int port);
// The value of a Content-Length header: decimal digits only, no sign, no overflow.
std::optional<size_t> ParseContentLength(std::string_view text);
}  // namespace QelHostWebRequest
