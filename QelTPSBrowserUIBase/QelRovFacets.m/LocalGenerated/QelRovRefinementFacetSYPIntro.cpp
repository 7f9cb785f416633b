#include "QelRovRefinementFacetSYPIntro.h"

#include "QelRovRefinementFacet.h"
#include "QelRovSYPIntroThunks.h"
#include "QelSYPMetaClassBuilder.h"

namespace {
using W = QelRovRefinementFacet;

const QelSYPPropertyRecord_int kIntProperties[] = {
    {"ExpandedFlag", "", "int", 1, "", 1, &QelRovSYPGetInt<W, &W::GetExpandedFlag>, nullptr, 0},
};

const QelSYPPropertyRecord_QelUnicodeString kTextProperties[] = {
    {"FacetName", "", "QelUnicodeString", 1, "", 1, &QelRovSYPGetText<W, &W::GetFacetName>, nullptr, 0},
    {"FacetIcon", "", "QelUnicodeString", 1, "", 1, &QelRovSYPGetText<W, &W::GetFacetIcon>, nullptr, 0},
};

const QelSYPEventHandlerRecord kHandlers[] = {
    {"OnExpanderExpanded", "QelSYPEventArgs", &QelRovSYPMakeHandler<W, &W::OnExpanderExpanded>},
    {"OnExpanderCollapsed", "QelSYPEventArgs", &QelRovSYPMakeHandler<W, &W::OnExpanderCollapsed>},
};

class QelRovRefinementFacetSYPMetaClassBuilder final : public QelSYPMetaClassBuilder {
 public:
  QelRovRefinementFacetSYPMetaClassBuilder() : QelSYPMetaClassBuilder("QelRovRefinementFacet", "QelTPSBrowserUIBase") {}
  void Build() override {
    SetProperties_int(kIntProperties, 1);
    SetProperties_QelUnicodeString(kTextProperties, 2);
    SetEventHandlers(kHandlers, 2);
    CreateMetaClass(&QelRovSYPCreate<W>, "QelVidCtl");
  }

 private:
  ~QelRovRefinementFacetSYPMetaClassBuilder() override = default;
};
}  // namespace

QelBaseUnknown* fctCreateQelRovRefinementFacetSYPMetaClassBuilder() {
  return new QelRovRefinementFacetSYPMetaClassBuilder();
}
