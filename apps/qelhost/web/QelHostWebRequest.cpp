#include "QelHostWebRequest.h"

#include <cmath>
#include <limits>
#include <nlohmann/json.hpp>

namespace {
using json = nlohmann::json;

// Bodies are small and flat; deep nesting is refused before the parser recurses into it.
constexpr int kMaxDepth = 8;
constexpr double kMaxZoom = 100.0;

bool TooDeep(std::string_view body) {
  int depth = 0;
  bool inString = false, escaped = false;
  for (char c : body) {
    if (inString) {
      if (escaped) escaped = false;
      else if (c == '\\') escaped = true;
      else if (c == '"') inString = false;
    } else if (c == '"') {
      inString = true;
    } else if (c == '{' || c == '[') {
      if (++depth > kMaxDepth) return true;
    } else if (c == '}' || c == ']') {
      --depth;
    }
  }
  return false;
}

bool ParseObject(std::string_view body, json& object, std::string& error) {
  if (body.size() > QelHostWebRequest::kMaxBody) {
    error = "the body is larger than 65536 bytes";
    return false;
  }
  if (TooDeep(body)) {
    error = "the body nests deeper than a request ever does";
    return false;
  }
  object = json::parse(body.begin(), body.end(), nullptr, false);
  if (object.is_discarded()) {
    error = "the body is not JSON";
    return false;
  }
  if (!object.is_object()) {
    error = "the body is not a JSON object";
    return false;
  }
  return true;
}

const json* Field(const json& object, const char* name, std::string& error) {
  auto it = object.find(name);
  if (it == object.end()) {
    error = std::string("missing field \"") + name + "\"";
    return nullptr;
  }
  return &*it;
}

bool Text(const json& object, const char* name, std::string& value, std::string& error) {
  const json* field = Field(object, name, error);
  if (!field) return false;
  if (!field->is_string()) {
    error = std::string("field \"") + name + "\" is not a text";
    return false;
  }
  value = field->get<std::string>();
  return true;
}

bool Integer(const json& object, const char* name, int least, int& value, std::string& error) {
  const json* field = Field(object, name, error);
  if (!field) return false;
  constexpr int64_t most = std::numeric_limits<int>::max();
  const bool whole = field->is_number_integer() && !(field->is_number_unsigned() && field->get<uint64_t>() > most);
  const int64_t v = whole ? field->get<int64_t>() : 0;
  if (!whole || v < least || v > most) {
    error = std::string("field \"") + name + "\" is not a whole number from " + std::to_string(least);
    return false;
  }
  value = static_cast<int>(v);
  return true;
}

bool Number(const json& value, double& number) {
  if (!value.is_number()) return false;
  number = value.get<double>();
  return std::isfinite(number);
}

bool IsWidgetId(const std::string& id) {
  // "0", then ".N" steps; the printer gives no other form.
  if (id.empty() || id.size() > 256 || id[0] != '0') return false;
  for (size_t i = 1; i < id.size(); ++i) {
    if (id[i] != '.' || i + 1 >= id.size()) return false;
    size_t digits = 0;
    while (i + 1 < id.size() && id[i + 1] >= '0' && id[i + 1] <= '9') ++i, ++digits;
    if (digits == 0 || digits > 6) return false;
  }
  return true;
}
}  // namespace

bool QelHostWebRequest::ParseEvent(std::string_view body, QelHostWebEvent& event, std::string& error) {
  json object;
  if (!ParseObject(body, object, error)) return false;
  event = {};
  std::string type;
  if (!Text(object, "id", event.id, error) || !Text(object, "type", type, error)) return false;
  if (!IsWidgetId(event.id)) {
    error = "\"" + event.id.substr(0, 40) + "\" is not a widget id such as 0.3.1";
    return false;
  }
  static const std::pair<const char*, QelHostWebEvent::Type> kTypes[] = {
      {"click", QelHostWebEvent::Type::Click},   {"text", QelHostWebEvent::Type::Text},
      {"select", QelHostWebEvent::Type::Select}, {"expand", QelHostWebEvent::Type::Expand},
      {"collapse", QelHostWebEvent::Type::Collapse}, {"scroll", QelHostWebEvent::Type::Scroll}};
  bool known = false;
  for (const auto& [name, value] : kTypes)
    if (type == name) event.type = value, known = true;
  if (!known) {
    error = "unknown event type \"" + type.substr(0, 40) + "\" (click, text, select, expand, collapse or scroll)";
    return false;
  }
  switch (event.type) {
    case QelHostWebEvent::Type::Text: return Text(object, "text", event.text, error);
    case QelHostWebEvent::Type::Select: return Integer(object, "index", 0, event.index, error);
    case QelHostWebEvent::Type::Scroll:
      return Integer(object, "x", 0, event.x, error) && Integer(object, "y", 0, event.y, error);
    default: return true;
  }
}

bool QelHostWebRequest::ParseAnswer(std::string_view body, bool& yes, std::string& error) {
  json object;
  std::string answer;
  if (!ParseObject(body, object, error) || !Text(object, "answer", answer, error)) return false;
  if (answer != "yes" && answer != "no") {
    error = "the answer is \"yes\" or \"no\"";
    return false;
  }
  yes = answer == "yes";
  return true;
}

bool QelHostWebRequest::ParseCamera(std::string_view body, QelHostWebCamera& camera, std::string& error) {
  json object;
  if (!ParseObject(body, object, error)) return false;
  const int given = int(object.contains("orbit")) + int(object.contains("zoom")) + int(object.contains("reframe"));
  if (given != 1) {
    error = "give exactly one of \"orbit\", \"zoom\" and \"reframe\"";
    return false;
  }
  camera = {};
  if (auto orbit = object.find("orbit"); orbit != object.end()) {
    camera.kind = QelHostWebCamera::Kind::Orbit;
    if (!orbit->is_array() || orbit->size() != 2 || !Number((*orbit)[0], camera.dx) ||
        !Number((*orbit)[1], camera.dy) || std::abs(camera.dx) > 360.0 || std::abs(camera.dy) > 360.0) {
      error = "\"orbit\" is [dx, dy], two angles in degrees up to 360";
      return false;
    }
  } else if (auto zoom = object.find("zoom"); zoom != object.end()) {
    camera.kind = QelHostWebCamera::Kind::Zoom;
    if (!Number(*zoom, camera.factor) || camera.factor < 1.0 / kMaxZoom || camera.factor > kMaxZoom) {
      error = "\"zoom\" is a factor from 0.01 to 100";
      return false;
    }
  } else if (object.at("reframe") != true) {
    error = "\"reframe\" takes only true";
    return false;
  }
  return true;
}

bool QelHostWebRequest::ParseActivate(std::string_view body, int& item, std::string& error) {
  json object;
  return ParseObject(body, object, error) && Integer(object, "item", 1, item, error);
}

std::vector<std::string> QelHostWebRequest::CookieValues(std::string_view header, std::string_view name) {
  std::vector<std::string> values;
  while (!header.empty()) {
    const size_t end = header.find(';');
    std::string_view pair = header.substr(0, end);
    header = end == std::string_view::npos ? std::string_view() : header.substr(end + 1);
    const size_t start = pair.find_first_not_of(' ');
    if (start == std::string_view::npos) continue;
    pair.remove_prefix(start);
    const size_t equals = pair.find('=');
    if (equals != std::string_view::npos && pair.substr(0, equals) == name)
      values.emplace_back(pair.substr(equals + 1));
  }
  return values;
}

bool QelHostWebRequest::IsOwnOrigin(std::string_view origin, int port) {
  const std::string suffix = ":" + std::to_string(port);
  return origin == "http://127.0.0.1" + suffix || origin == "http://localhost" + suffix;
}

std::optional<size_t> QelHostWebRequest::ParseContentLength(std::string_view text) {
  if (text.empty() || text.size() > 19) return std::nullopt;  // 19 digits always fit in 64 bits
  size_t value = 0;
  for (char c : text) {
    if (c < '0' || c > '9') return std::nullopt;
    value = value * 10 + static_cast<size_t>(c - '0');
  }
  return value;
}
