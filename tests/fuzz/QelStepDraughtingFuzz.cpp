// The presentation a STEP file's text gives (cameras, views' contents, drawn callouts):
// read from the bytes before anything else would refuse them. Whatever they hold, the
// reading ends, each view named has its camera, and drawings stay bounded.
#include <string_view>

#include "QelFuzzTarget.h"
#include "QelStepDraughting.h"

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  const QelStepDraughting file =
      QelStepDraughting::Scan(std::string_view(reinterpret_cast<const char*>(data), size));
  for (const std::string& name : file.ViewNames()) {
    const QelStepDraughting::Camera* camera = file.FindCamera(name);
    QelFuzzCheck(camera != nullptr, "every view named has its camera");
    for (const std::string& key : camera->shows) {
      QelFuzzCheck(!key.empty(), "a view shows named annotations");
      QelFuzzCheck(file.Drawing(key).size() <= 4000, "a drawing is bounded");
    }
  }
  for (size_t i = 0; i < file.DimensionNames().size(); ++i)
    QelFuzzCheck(file.DimensionScale(i) > 0.0, "a dimension's unit scales by a positive factor");
  return 0;
}
