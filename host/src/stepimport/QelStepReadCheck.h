#pragma once
// QelStepReadCheck: what the importer checks once the translator is done with a file:
// the entities whose transfer failed (the file is then refused, since the model would lack
// part of a shape or product without a word), and what the file declares (datums,
// tolerances, dimensions, saved views, tessellated shapes) against what the translated
// document holds, which becomes the model's list of what was not read.
#include <set>
#include <string>
#include <string_view>
#include <vector>

#include <STEPCAFControl_Reader.hxx>
#include <TDocStd_Document.hxx>

#include "QelModelBuilder.h"
#include "QelStepDataScan.h"

class QelStepReadCheck {
 public:
  QelStepReadCheck() = delete;

  // At most kMaxNamed entity numbers are listed per kind; the count is always whole.
  static constexpr size_t kMaxNamed = 20;

  // "#12 (VERTEX_POINT): <the translator's reason>" per entity whose transfer failed, at
  // most kMaxNamed; `text` is the file's text, where each entity's type is looked up.
  static std::vector<std::string> TransferFailures(STEPCAFControl_Reader& reader, std::string_view text);

  // The kinds the model lacks against the file's declarations. `annotationsRead` false:
  // no datum, tolerance or dimension was read at all. `views`: the names of the saved views
  // the model holds (the importer reads them from the file where the translator cannot).
  static std::vector<QelModelNotRead> Missing(const QelStepDataScan& scan, const Handle(TDocStd_Document)& document,
                                              bool annotationsRead, const std::multiset<std::string>& views);

  // The type keyword of entity #id in `text`, or "".
  static std::string TypeOf(std::string_view text, uint64_t id);
};
