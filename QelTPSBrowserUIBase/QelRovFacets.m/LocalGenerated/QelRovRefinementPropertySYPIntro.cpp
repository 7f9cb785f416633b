#include "QelRovRefinementPropertySYPIntro.h"

#include "QelRovRefinementProperty.h"
#include "QelRovSYPIntroThunks.h"
#include "QelSYPMetaClassBuilder.h"

namespace {
using W = QelRovRefinementProperty;

const QelSYPPropertyRecord_QelVidColor kColorProperties[] = {
    {"LineColor", "", "QelVidColor", 1, "", 1, &QelRovSYPGetColor<W, &W::GetLineColor>, nullptr, 0},
    {"BorderColor", "", "QelVidColor", 1, "", 1, &QelRovSYPGetColor<W, &W::GetBorderColor>, nullptr, 0},
};

const QelSYPPropertyRecord_int kIntProperties[] = {
    {"IconVisibility", "", "int", 1, "", 1, &QelRovSYPGetInt<W, &W::GetIconVisibility>, nullptr, 0},
    {"CheckState", "", "int", 0, "", 1, &QelRovSYPGetInt<W, &W::GetCheckState>, &QelRovSYPSetInt<W, &W::SetChecked>,
     0},
    {"ExpandedFlag", "", "int", 1, "", 1, &QelRovSYPGetInt<W, &W::GetExpandedFlag>, nullptr, 0},
    {"CheckBoxVisibility", "", "int", 1, "", 1, &QelRovSYPGetInt<W, &W::GetCheckBoxVisibility>, nullptr, 0},
    {"RadioVisibility", "", "int", 1, "", 1, &QelRovSYPGetInt<W, &W::GetRadioVisibility>, nullptr, 0},
    {"RightPartEnableFlag", "", "int", 1, "", 1, &QelRovSYPGetInt<W, &W::GetRightPartEnableFlag>, nullptr, 0},
    {"RangeButtonEnableFlag", "", "int", 1, "", 1, &QelRovSYPGetInt<W, &W::GetRangeButtonEnableFlag>, nullptr, 0},
};

const QelSYPPropertyRecord_QelUnicodeString kTextProperties[] = {
    {"PropertyName", "", "QelUnicodeString", 1, "", 1, &QelRovSYPGetText<W, &W::GetPropertyName>, nullptr, 0},
    {"Icon", "", "QelUnicodeString", 1, "", 1, &QelRovSYPGetText<W, &W::GetIcon>, nullptr, 0},
    {"LeftValue", "", "QelUnicodeString", 1, "", 1, &QelRovSYPGetText<W, &W::GetLeftValue>, nullptr, 0},
    {"RightValue", "", "QelUnicodeString", 1, "", 1, &QelRovSYPGetText<W, &W::GetRightValue>, nullptr, 0},
};

const QelSYPEventHandlerRecord kHandlers[] = {
    {"OnClick", "QelSYPEventArgs", &QelRovSYPMakeHandler<W, &W::OnClick>},
    {"OnExpanderExpanded", "QelSYPEventArgs", &QelRovSYPMakeHandler<W, &W::OnExpanderExpanded>},
    {"OnExpanderCollapsed", "QelSYPEventArgs", &QelRovSYPMakeHandler<W, &W::OnExpanderCollapsed>},
    {"OnMouseEnter", "QelSYPEventArgs", &QelRovSYPMakeHandler<W, &W::OnMouseEnter>},
    {"OnMouseLeave", "QelSYPEventArgs", &QelRovSYPMakeHandler<W, &W::OnMouseLeave>},
    {"LeftEditorEvent", "QelSYPEventArgs", &QelRovSYPMakeHandler<W, &W::LeftEditorEvent>},
    {"LeftComboSelectedEvent", "QelSYPEventArgs", &QelRovSYPMakeHandler<W, &W::LeftComboSelectedEvent>},
    {"RightComboSelectedEvent", "QelSYPEventArgs", &QelRovSYPMakeHandler<W, &W::RightComboSelectedEvent>},
    {"RightEditorEvent", "QelSYPEventArgs", &QelRovSYPMakeHandler<W, &W::RightEditorEvent>},
    {"OnRangeUpdate", "QelSYPEventArgs", &QelRovSYPMakeHandler<W, &W::OnRangeUpdate>},
};

class QelRovRefinementPropertySYPMetaClassBuilder final : public QelSYPMetaClassBuilder {
 public:
  QelRovRefinementPropertySYPMetaClassBuilder()
      : QelSYPMetaClassBuilder("QelRovRefinementProperty", "QelTPSBrowserUIBase") {}
  void Build() override {
    SetProperties_QelVidColor(kColorProperties, 2);
    SetProperties_int(kIntProperties, 7);
    SetProperties_QelUnicodeString(kTextProperties, 4);
    SetEventHandlers(kHandlers, 10);
    CreateMetaClass(&QelRovSYPCreate<W>, "QelVidCtl");
  }

 private:
  ~QelRovRefinementPropertySYPMetaClassBuilder() override = default;
};
}  // namespace

QelBaseUnknown* fctCreateQelRovRefinementPropertySYPMetaClassBuilder() {
  return new QelRovRefinementPropertySYPMetaClassBuilder();
}
