// libQelWidgetsPreview.so: the panel's facet widgets over small facets made from the
// loaded model (its annotation sets, its views and captures), until the module's own
// facets drive the panel. qelhost loads it after the module, like any plug-in, and calls
// QelWidgetsPreviewRun; a click goes to the named row's check box or radio through the
// same events the styles route, so the row, the facet and the display change together.
#include <cstdio>
#include <string>
#include <vector>

#include "QelDictionary.h"
#include "QelIRovFacetPropertyObserver.h"
#include "QelRovFacet.h"
#include "QelRovFacetPropertyItemAnnotSet.h"
#include "QelRovFacetPropertyItemViewCapture.h"
#include "QelRovFacetServices.h"
#include "QelRovRefinementFacet.h"
#include "QelRovRefinementProperty.h"
#include "QelSYPWRefMethEventHandler.h"
#include "QelTie.h"
#include "QelVidCtlCheckButton.h"
#include "QelVidLayGrid.h"
#include "QelVidWidgetPrinter.h"

namespace {
constexpr const char* kFramework = "QelWidgetsPreview";

// A facet over a fixed list of items; every change is taken as applied by the items.
class QelPreviewFacet final : public QelRovFacet {
 public:
  static const QelMetaObject& MetaObject() {
    static const QelMetaObject& meta =
        QelMetaObject::Declare("QelPreviewFacet", QelMetaKind::Implementation, &QelRovFacet::MetaObject(), kFramework);
    return meta;
  }
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

  explicit QelPreviewFacet(const char* name) : QelRovFacet(nullptr) { SetFacetName(QelUnicodeString(name)); }
  void Add(QelBaseUnknown* property) { PropertyList().Append(property); }
  void Refresh() override {}
  // No facet group to tell: the items already changed the display.
  HRESULT ApplyPropertyChange(QelBaseUnknown*) override { return S_FALSE; }

 private:
  ~QelPreviewFacet() override = default;
};

class TieObserverPreviewFacet final : public QelTie<QelIRovFacetPropertyObserver> {
 public:
  using QelTie::QelTie;
  HRESULT CanChangeCheckState(QelBaseUnknown* p, QelCheckState s) override {
    return Impl<QelPreviewFacet>()->CanChangeCheckState(p, s);
  }
  HRESULT OnPropertyChanged(QelBaseUnknown* p) override { return Impl<QelPreviewFacet>()->OnPropertyChanged(p); }

 private:
  ~TieObserverPreviewFacet() override = default;
};

// The dialog's part: facet widgets in a grid, all built again after every click.
class QelPreviewPanel final : public QelVidWidget {
 public:
  QelPreviewPanel() : QelVidWidget(nullptr, QelString("Panel")) {
    grid_ = QelMakeVar<QelVidLayGrid>(this, QelString("DialogGrid"));
    AddChild(grid_.get());
  }
  void AddFacet(QelBaseUnknown* facet) { facets_.emplace_back(facet); }
  void Rebuild() {
    while (grid_->GetChildCount() > 0) grid_->RemoveWidget(grid_->GetChild(0));
    int row = 0;
    for (size_t i = 0; i < facets_.size(); ++i) {
      auto widget = QelMakeVar<QelRovRefinementFacet>(this, QelString("Facet" + std::to_string(i)), facets_[i].get());
      if (QelFailed(widget->BuildPropertyWidgets())) continue;
      QelSYPWRefMethEventHandler<QelPreviewPanel>::Connect(widget.get(), QelRovRefinementFacet::SendFacetEvent(),
                                                           this, &QelPreviewPanel::OnFacetEvent);
      grid_->AddWidget(widget.get(), {0, row++, 1, 1, 1, 1, 1, 0});
    }
  }
  void OnFacetEvent(QelBaseUnknown*, QelSYPEventArgs*) { Rebuild(); }

 private:
  ~QelPreviewPanel() override = default;
  std::vector<QelBaseUnknown_var> facets_;
  QelVar<QelVidLayGrid> grid_;
};

// The visible check box or radio of the row named `rowName`, or null.
QelVidCtlCheckButton* FindRowButton(QelVidWidget* panel, const std::string& rowName) {
  auto* row = dynamic_cast<QelRovRefinementProperty*>(panel->FindDescendant(rowName));
  if (!row) return nullptr;
  for (const char* part : {"CheckBox", "RadioButton"}) {
    auto* button = dynamic_cast<QelVidCtlCheckButton*>(row->RetrieveSypNamedObject(QelString(part)));
    if (button && button->GetVisibleFlag()) return button;
  }
  return nullptr;
}

void Print(QelVidWidget* panel, bool json) {
  std::fputs((json ? QelVidPrintJson(panel) + "\n" : QelVidPrintText(panel)).c_str(), stdout);
}
}  // namespace

// Builds the preview panel over `root`, prints it, then clicks each named row in turn
// and prints the panel again. 0, or 1 when a row name is unknown (the rest is skipped).
extern "C" int QelWidgetsPreviewRun(QelBaseUnknown* root, const char* const* clicks, int count, int json) {
  QelDictionary::Get().Register("QelPreviewFacet", QelIRovFacetPropertyObserver::IID,
                                &QelCreateTie<TieObserverPreviewFacet>, kFramework);
  auto sets = QelMakeVar<QelPreviewFacet>("Annotation sets");
  QelListValQelBaseUnknown_var list;
  QelRovFacetServices::ListAllSets(root, list, true);
  for (const auto& set : list) {
    auto item = QelMakeVar<QelRovFacetPropertyItemAnnotSet>(set.get(), root, QelListValQelBaseUnknown_var(), sets.get());
    sets->Add(item.get());
  }
  auto views = QelMakeVar<QelPreviewFacet>("Views and captures");
  list.RemoveAll();
  QelRovFacetServices::ListCapturesAndViewsOfVisibleSets(root, list);
  for (const auto& view : list) {
    auto item = QelMakeVar<QelRovFacetPropertyItemViewCapture>(view.get(), root, nullptr, views.get());
    views->Add(item.get());
  }
  auto panel = QelMakeVar<QelPreviewPanel>();
  panel->AddFacet(sets.get());
  panel->AddFacet(views.get());
  panel->Rebuild();
  Print(panel.get(), json != 0);
  int status = 0;
  for (int i = 0; i < count && status == 0; ++i) {
    QelVidCtlCheckButton* button = FindRowButton(panel.get(), clicks[i]);
    if (!button) {
      std::fprintf(stderr, "qelhost: --widgets: no row '%s' to click\n", clicks[i]);
      status = 1;
      break;
    }
    std::printf("\nclick %s\n", clicks[i]);
    button->Click();
    Print(panel.get(), json != 0);
  }
  QelDictionary::Get().RemoveFramework(kFramework);
  return status;
}
