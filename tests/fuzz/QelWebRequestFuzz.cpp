// The review page's request bodies: the input is one body, read as each of the four
// requests. None throws or crashes; what is accepted holds only values the server can use
// without further checks (a widget id of the printer's form, finite bounded camera
// moves, an item from 1, non-negative selection and scroll values).
#include <cmath>

#include "QelFuzzTarget.h"
#include "QelHostWebRequest.h"

namespace {
bool IsWidgetIdForm(const std::string& id) {
  if (id.empty() || id[0] != '0') return false;
  for (size_t i = 1; i < id.size(); ++i)
    if (id[i] != '.' && (id[i] < '0' || id[i] > '9')) return false;
  return id.back() != '.' && id.find("..") == std::string::npos && (id.size() == 1 || id[1] == '.');
}
}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  const std::string_view body(reinterpret_cast<const char*>(data), size);
  std::string error;

  QelHostWebEvent event;
  if (QelHostWebRequest::ParseEvent(body, event, error)) {
    QelFuzzCheck(IsWidgetIdForm(event.id), "an accepted event names a widget id");
    QelFuzzCheck(event.index >= 0 && event.x >= 0 && event.y >= 0, "selection and scroll values are not negative");
  } else {
    QelFuzzCheck(!error.empty(), "a refused event says why");
  }

  bool yes = false;
  error.clear();
  QelFuzzCheck(QelHostWebRequest::ParseAnswer(body, yes, error) || !error.empty(), "a refused answer says why");

  QelHostWebCamera camera;
  error.clear();
  if (QelHostWebRequest::ParseCamera(body, camera, error)) {
    QelFuzzCheck(std::isfinite(camera.dx) && std::isfinite(camera.dy) && std::abs(camera.dx) <= 360 &&
                     std::abs(camera.dy) <= 360,
                 "orbit angles are finite and bounded");
    QelFuzzCheck(camera.factor >= 0.01 && camera.factor <= 100, "a zoom factor is bounded");
  } else {
    QelFuzzCheck(!error.empty(), "a refused camera move says why");
  }

  int item = 0;
  error.clear();
  if (QelHostWebRequest::ParseActivate(body, item, error)) QelFuzzCheck(item >= 1, "an item is numbered from 1");
  else QelFuzzCheck(!error.empty(), "a refused activation says why");
  return 0;
}
