#pragma once
// QelStepImporter: opens a STEP file (AP242 with semantic annotations, or another protocol
// for its shapes only) as a product model, the same in-memory model the JSON loader
// builds: products with placements and tessellated shapes, one annotation set per product
// that owns annotations, datums, tolerances and dimensions, and the saved views with one
// capture each. All or nothing: a refused file leaves no object behind. The file's bytes
// are scanned first (QelStepDataScan); the translation library then runs in a child
// process under limits, which hands the model back, so that damaged data can crash or
// stall only the child. What the file holds and the translator did not read is the
// model's list of what was not read (QelModelBuilder::NotRead).
#include <functional>
#include <string>
#include <vector>

#include "QelVar.h"

struct QelStepImportOptions {
  // Told the stage ("reading", "translating", "tessellating", "annotations") and the part
  // of the whole import done (0 to 1), a few hundred times at most; may be empty. It is
  // called in the child process: it may print, but what it changes stays there.
  std::function<void(const char* stage, double done)> progress{};
};

class QelStepImporter {
 public:
  QelStepImporter() = delete;

  // The tessellation tolerance: the chordal deviation is this part of the diagonal of a
  // part's bounding box, kept between the two bounds (millimetres), and the angular one
  // is fixed. A part's triangles thus stay within a known distance of its surfaces, and
  // a huge part cannot ask for an unbounded number of them.
  static constexpr double kRelativeDeflection = 0.002;
  static constexpr double kMinDeflection = 0.01;
  static constexpr double kMaxDeflection = 2.0;
  static constexpr double kAngularDeflection = 0.5;  // radians

  // Whether the file begins as a STEP file does ("ISO-10303-21;"), whatever its name.
  static bool IsStepFile(const std::string& path);

  // S_OK and the root product; `notes` gets what a person should know about a file that
  // opened (a protocol without annotations, annotations left out, what was not read).
  // E_FAIL, a null root and one message "<path>: ..." otherwise, naming the line and
  // entity where known. No exception and no signal of the translator leaves the call.
  static HRESULT ImportFile(const std::string& path, QelBaseUnknown_var& root, std::string& error,
                            std::vector<std::string>& notes, const QelStepImportOptions& options = {});
};
