#include "QelDbrFraPanel.h"

#include <algorithm>

#include "QelDelayedDestruction.h"

namespace {
struct DockEntry {
  QelBaseUnknown_WR viewer;
  QelVar<QelDbrFraPanel> panel;
};

// The docks of every viewer. An entry whose viewer is gone is dropped on the next look,
// so a viewer closed without undocking does not keep its panels for ever.
std::vector<DockEntry>& Docks() {
  static std::vector<DockEntry> docks;
  return docks;
}

void DropDeadViewers() {
  auto& docks = Docks();
  std::vector<QelVar<QelDbrFraPanel>> dropped;  // released after the list is consistent
  for (auto it = docks.begin(); it != docks.end();) {
    if (it->viewer.Get()) {
      ++it;
      continue;
    }
    dropped.push_back(std::move(it->panel));
    it = docks.erase(it);
  }
}
}  // namespace

const QelMetaObject& QelDbrFraPanel::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelDbrFraPanel", QelMetaKind::Implementation, &QelVidWidget::MetaObject(), "QelHost");
  return meta;
}
const QelMetaObject* QelDbrFraPanel::GetMetaObject() const { return &MetaObject(); }

QelDbrFraPanel::QelDbrFraPanel(QelBaseUnknown*, const QelString& name, QelVidWidget* content, int allowedDockAreas,
                               int dockArea, bool floating)
    : QelVidWidget(nullptr, name), allowedDockAreas_(allowedDockAreas), dockArea_(dockArea), floating_(floating) {
  if (content) AddChild(content);
}

QelDbrFraPanel::~QelDbrFraPanel() = default;

void QelDbrFraPanel::SetDefaultButton(QelVidWidget* button) { defaultButton_ = QelBaseUnknown_WR(button); }

QelVidWidget* QelDbrFraPanel::GetDefaultButton() const {
  return QelSysDynamicCast<QelVidWidget>(defaultButton_.GetRaw());
}

void QelDbrFraPanel::SetApplicativeWidget(QelVidWidget* content) {
  if (content && content == GetApplicativeWidget()) return;
  QelVar<QelDbrFraPanel> hold = QelVar<QelDbrFraPanel>::Retain(this);
  while (GetChildCount() > 0) RemoveChild(GetChild(0));
  if (content) AddChild(content);
}

HRESULT QelDbrFraPanel::InsertInViewer(QelBaseUnknown* viewer) {
  if (!viewer) return E_FAIL;
  if (destructionRequested_) return E_FAIL;
  if (GetViewer() && GetViewer()->IsEqual(viewer)) return S_FALSE;
  QelVar<QelDbrFraPanel> hold = QelVar<QelDbrFraPanel>::Retain(this);
  LeaveDock();
  Docks().push_back({QelBaseUnknown_WR(viewer), hold});
  return S_OK;
}

QelBaseUnknown* QelDbrFraPanel::GetViewer() const {
  for (const auto& entry : Docks())
    if (entry.panel.get() == this) return entry.viewer.GetRaw();
  return nullptr;
}

std::vector<QelDbrFraPanel*> QelDbrFraPanel::PanelsInViewer(QelBaseUnknown* viewer) {
  DropDeadViewers();
  std::vector<QelDbrFraPanel*> panels;
  if (!viewer) return panels;
  for (const auto& entry : Docks()) {
    QelBaseUnknown* docked = entry.viewer.GetRaw();
    if (docked && docked->IsEqual(viewer)) panels.push_back(entry.panel.get());
  }
  return panels;
}

void QelDbrFraPanel::LeaveDock() {
  auto& docks = Docks();
  auto it = std::find_if(docks.begin(), docks.end(), [this](const DockEntry& e) { return e.panel.get() == this; });
  if (it == docks.end()) return;
  QelVar<QelDbrFraPanel> released = std::move(it->panel);
  docks.erase(it);
}

void QelDbrFraPanel::RequestDelayedDestruction() {
  if (destructionRequested_) return;
  destructionRequested_ = true;
  // The queue's reference is taken before the dock lets go, so the panel outlives the
  // dispatch that asked for its end.
  QelDelayedDestruction::Request(this);
  LeaveDock();
}
