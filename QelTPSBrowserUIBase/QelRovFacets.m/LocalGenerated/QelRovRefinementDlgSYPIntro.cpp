#include "QelRovRefinementDlgSYPIntro.h"

#include "QelRovRefinementDlg.h"
#include "QelRovSYPIntroThunks.h"
#include "QelSYPMetaClassBuilder.h"

namespace {
using W = QelRovRefinementDlg;

const QelSYPPropertyRecord_int kIntProperties[] = {
    {"RefreshButtonEnableFlag", "", "int", 0, "", 1, &QelRovSYPGetInt<W, &W::GetRefreshButtonEnableFlag>,
     &QelRovSYPSetInt<W, &W::SetRefreshButtonEnableFlag>, 0},
};

const QelSYPEventHandlerRecord kHandlers[] = {
    {"OnRefresh", "QelSYPEventArgs", &QelRovSYPMakeHandler<W, &W::OnRefresh>},
    {"OnClose", "QelSYPEventArgs", &QelRovSYPMakeHandler<W, &W::OnClose>},
};

class QelRovRefinementDlgSYPMetaClassBuilder final : public QelSYPMetaClassBuilder {
 public:
  QelRovRefinementDlgSYPMetaClassBuilder() : QelSYPMetaClassBuilder("QelRovRefinementDlg", "QelTPSBrowserUIBase") {}
  void Build() override {
    SetProperties_int(kIntProperties, 1);
    SetEventHandlers(kHandlers, 2);
    CreateMetaClass(&QelRovSYPCreate<W>, "QelVidCtl");
  }

 private:
  ~QelRovRefinementDlgSYPMetaClassBuilder() override = default;
};
}  // namespace

QelBaseUnknown* fctCreateQelRovRefinementDlgSYPMetaClassBuilder() { return new QelRovRefinementDlgSYPMetaClassBuilder(); }
