#include "QelRovFacetController.h"

#include "QelApplicationFrame.h"
#include "QelAssert.h"
#include "QelFrmContext.h"
#include "QelFrmEditor.h"
#include "QelFrmLayout.h"
#include "QelRovFacetGroup.h"
#include "QelRovFacetServices.h"
#include "QelSettingNotif.h"
#include "QelSettingRepository.h"

namespace {
constexpr const char* kRepository = "QelRovDataFiltering";
constexpr const char* kKeyPrefix = "DataFilteringPanel_";

QelRovFacetController*& Instance() {
  static QelRovFacetController* controller = nullptr;
  return controller;
}

QelString KeyOf(const QelString& workbench) { return QelString(std::string(kKeyPrefix) + workbench.CastToCharPtr()); }
}  // namespace

const QelMetaObject& QelRovFacetController::MetaObject() {
  // The controller derives from the host's interface, so a host asking IsAKindOf by the
  // interface's name is answered yes; the host declares nothing for it, hence the
  // declaration here (Declare gives the existing record when there is one).
  static const QelMetaObject& base = QelMetaObject::Declare("QelIHyxFacetCtrl", QelMetaKind::Implementation,
                                                            &QelBaseUnknown::MetaObject(), "QelHost");
  static const QelMetaObject& meta =
      QelMetaObject::Declare(ClassName(), QelMetaKind::Implementation, &base, "QelTPSBrowserUIBase");
  return meta;
}
const char* QelRovFacetController::ClassName() { return "QelRovFacetController"; }
const char* QelRovFacetController::ClassId() { return MetaObject().Name(); }
const QelMetaObject* QelRovFacetController::GetMetaObject() const { return &MetaObject(); }

void* QelRovFacetController::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelIHyxFacetCtrl>(this, iid)) return mine;
  return QelBaseUnknown::QueryDirect(iid);
}

QelBaseUnknown* QelRovFacetController::Create() {
  if (!QelRovFacetServices::IsRefinementDevActive()) return nullptr;
  QelRovFacetController*& instance = Instance();
  // The process-wide pointer owns the creation reference.
  if (!instance) instance = QelMakeVar<QelRovFacetController>().Detach();
  instance->AddRef();
  return instance;
}

void QelRovFacetController::ReleaseAtUnload() {
  QelRovFacetController*& instance = Instance();
  if (!instance) return;
  QelRovFacetController* controller = instance;
  controller->RemoveCallbacks();
  instance = nullptr;
  controller->Release();
}

QelBaseUnknown* QelRovFacetController::CreateItself() { return Create(); }

QelRovFacetController* QelRovFacetController::GetDataFilterController() { return Instance(); }

QelRovFacetController::QelRovFacetController() {
  QelCallbackManager& callbacks = QelCallbackManager::Get();
  if (QelFrmLayout* layout = QelFrmLayout::GetCurrentLayout())
    activeObjectSubscription_ = callbacks.AddCallback(layout, kQelUIActiveObjectChanged, this,
                                                      [this](QelBaseUnknown*, QelBaseUnknown*) { OnUIActiveObjectChanged(); });
  if (QelApplicationFrame* frame = QelApplicationFrame::GetFrame())
    workbenchSubscription_ = callbacks.AddCallback(frame->GetDispatcher(), kQelAfrAccessChanged, this,
                                                   [this](QelBaseUnknown*, QelBaseUnknown*) { OnWorkbenchChanged(); });
  repository_ = QelSettingRepository::GetRepository(kRepository, 0, 1, nullptr);
  if (!repository_) {
    QelAssertPointer("QelSettingRepository");
    return;
  }
  settingSubscription_ = callbacks.AddCallback(
      repository_, kQelRepositoryModified, this,
      [this](QelBaseUnknown*, QelBaseUnknown* notification) { OnSettingModified(notification); });
}

QelRovFacetController::~QelRovFacetController() {
  RemoveCallbacks();
  groups_.RemoveAll();
}

int QelRovFacetController::ReadDataFilteringPanelSetting(QelString workbench) const {
  const std::string name = workbench.CastToCharPtr();
  if (name != "LumReview" && name != "TPSCfg" && name != "GopLookoutWorkbench") return 0;
  if (!repository_) {
    QelAssertPointer("QelSettingRepository");
    return 0;
  }
  const QelString key = KeyOf(workbench);
  int value = 0;
  if (repository_->IsPresent(key.CastToCharPtr(), "int")) repository_->ReadSetting(key.CastToCharPtr(), &value, 1);
  return value;
}

void QelRovFacetController::CreateDataFilteringPanelIfNecessary() {
  QelFrmEditor* editor = QelFrmEditor::GetCurrentEditor();
  QelFrmContext* context = QelFrmContext::GetContext();
  if (!context) return QelAssertPointer("QelFrmContext");
  if (ReadDataFilteringPanelSetting(context->GetWorkbenchName()) == 1)
    CreateDataFilteringPanel(editor);
  else
    DestroyDataFilteringPanel(editor);
}

void QelRovFacetController::CloseDataFilteringPanel() {
  QelFrmContext* context = QelFrmContext::GetContext();
  if (!repository_ || !context) return QelAssertPointer(repository_ ? "QelFrmContext" : "QelSettingRepository");
  // The repository's notification of this write takes the panel away.
  const int off = 0;
  repository_->WriteSetting(KeyOf(context->GetWorkbenchName()).CastToCharPtr(), &off, 1, 0);
  repository_->SaveRepository(nullptr);
}

void QelRovFacetController::CreateDataFilteringPanel(QelFrmEditor* editor) {
  if (!editor) return QelAssertPointer("QelFrmEditor");
  QelRovFacetGroup* group = GiveExistingFacetGroupOfEditor(editor);
  if (!group) group = InitFacetGroupOfEditor(editor);
  QelFrmLayout* layout = QelFrmLayout::GetCurrentLayout();
  // S_FALSE: nothing could be placed yet; try again at each window activation.
  if (group && group->CreatePanel() == S_FALSE) {
    if (!windowSubscription_ && layout)
      windowSubscription_ = QelCallbackManager::Get().AddCallback(
          layout, kQelWindowActivated, this, [this](QelBaseUnknown*, QelBaseUnknown*) { OnWindowActivated(); });
    return;
  }
  if (windowSubscription_) {
    if (layout) QelCallbackManager::Get().RemoveCallbacksOn(layout, this, kQelWindowActivated);
    windowSubscription_ = 0;
  }
}

void QelRovFacetController::DestroyDataFilteringPanel(QelFrmEditor* editor) {
  if (!editor) return QelAssertPointer("QelFrmEditor");
  QelRovFacetGroup* group = GiveExistingFacetGroupOfEditor(editor);
  if (!group) return;
  QelBaseUnknown_var hold = QelBaseUnknown_var::Retain(group);
  group->ClosePanel();
  groups_.RemoveValue(hold.get());
}

void QelRovFacetController::RefreshDataFilteringPanel(QelFrmEditor* editor) {
  DestroyDataFilteringPanel(editor);
  CreateDataFilteringPanel(editor);
}

QelRovFacetGroup* QelRovFacetController::GiveExistingFacetGroupOfEditor(QelFrmEditor* editor) const {
  if (!editor) {
    QelAssertPointer("QelFrmEditor");
    return nullptr;
  }
  for (int i = groups_.Size(); i >= 1; --i) {
    auto* group = QelSysDynamicCast<QelRovFacetGroup>(groups_[i].get());
    if (!group) {
      QelAssertPointer("QelRovFacetGroup");
      continue;
    }
    if (QelFrmEditor* own = group->GetEditor(); own && own->IsEqual(editor)) return group;
  }
  return nullptr;
}

QelRovFacetGroup* QelRovFacetController::InitFacetGroupOfEditor(QelFrmEditor* editor) {
  if (!editor) {
    QelAssertPointer("QelFrmEditor");
    return nullptr;
  }
  if (QelRovFacetGroup* group = GiveExistingFacetGroupOfEditor(editor)) return group;
  QelVar<QelPathElement> path = editor->GetUIActivePath();
  path->InitToLeafElement();
  if (!path->NextFatherElement()) return nullptr;
  QelVar<QelRovFacetGroup> group = QelMakeVar<QelRovFacetGroup>(editor);
  groups_.Append(static_cast<QelBaseUnknown*>(group.get()));
  if (!editorCloseSubscription_)
    if (QelFrmLayout* layout = QelFrmLayout::GetCurrentLayout())
      editorCloseSubscription_ = QelCallbackManager::Get().AddCallback(
          layout, kQelEditorCloseEnded, this,
          [this](QelBaseUnknown*, QelBaseUnknown* closed) { OnEditorClosed(closed); });
  return GiveExistingFacetGroupOfEditor(editor);
}

HRESULT QelRovFacetController::ShowPanelOf(QelFrmEditor* editor, bool show) {
  if (!editor) {
    QelAssertPointer("QelFrmEditor");
    return E_UNEXPECTED;
  }
  QelRovFacetController* controller = GetDataFilterController();
  QelRovFacetGroup* group = controller ? controller->GiveExistingFacetGroupOfEditor(editor) : nullptr;
  if (!group) return S_FALSE;
  group->ShowPanel(show);
  return S_OK;
}

HRESULT QelRovFacetController::HideDataFilteringPanel(QelFrmEditor* editor) { return ShowPanelOf(editor, false); }
HRESULT QelRovFacetController::RestoreDataFilteringPanel(QelFrmEditor* editor) { return ShowPanelOf(editor, true); }

bool QelRovFacetController::IsDataFilteringPanelInitialized(QelFrmEditor* editor) const {
  if (!editor) {
    QelAssertPointer("QelFrmEditor");
    return false;
  }
  QelRovFacetGroup* group = GiveExistingFacetGroupOfEditor(editor);
  return group && group->IsPanelInitialized();
}

void QelRovFacetController::RemoveCallbacks() {
  QelCallbackManager& callbacks = QelCallbackManager::Get();
  if (QelFrmLayout* layout = QelFrmLayout::GetCurrentLayout()) {
    if (editorCloseSubscription_) callbacks.RemoveCallbacksOn(layout, this, kQelEditorCloseEnded);
    if (activeObjectSubscription_) callbacks.RemoveCallbacksOn(layout, this, kQelUIActiveObjectChanged);
    if (windowSubscription_) callbacks.RemoveCallbacksOn(layout, this, kQelWindowActivated);
  }
  editorCloseSubscription_ = activeObjectSubscription_ = windowSubscription_ = 0;
  if (workbenchSubscription_)
    if (QelApplicationFrame* frame = QelApplicationFrame::GetFrame())
      callbacks.RemoveCallbacksOn(frame->GetDispatcher(), this, kQelAfrAccessChanged);
  workbenchSubscription_ = 0;
  // By identifier: the repository may have gone with the settings service already.
  if (settingSubscription_) callbacks.RemoveCallback(settingSubscription_);
  settingSubscription_ = 0;
  repository_ = nullptr;
}

void QelRovFacetController::OnEditorClosed(QelBaseUnknown* closed) {
  auto* editor = QelSysDynamicCast<QelFrmEditor>(closed);
  if (!editor) return QelAssertPointer("QelFrmEditor");
  DestroyDataFilteringPanel(editor);
}

void QelRovFacetController::OnUIActiveObjectChanged() {
  QelFrmEditor* editor = QelFrmEditor::GetCurrentEditor();
  QelFrmContext* context = QelFrmContext::GetContext();
  if (!editor || !context) return QelAssertPointer(editor ? "QelFrmContext" : "QelFrmEditor");
  if (ReadDataFilteringPanelSetting(context->GetWorkbenchName()) != 1) return;
  if (QelRovFacetGroup* group = GiveExistingFacetGroupOfEditor(editor)) group->RefreshPanel();
}

void QelRovFacetController::OnWindowActivated() {
  QelFrmContext* context = QelFrmContext::GetContext();
  if (!context) return QelAssertPointer("QelFrmContext");
  if (ReadDataFilteringPanelSetting(context->GetWorkbenchName()) != 0)
    CreateDataFilteringPanel(QelFrmEditor::GetCurrentEditor());
}

void QelRovFacetController::OnWorkbenchChanged() {
  QelFrmContext* context = QelFrmContext::GetContext();
  if (!context) return QelAssertPointer("QelFrmContext");
  QelFrmEditor* editor = QelFrmEditor::GetCurrentEditor();
  if (!editor) return;
  const int setting = ReadDataFilteringPanelSetting(context->GetNextWorkbenchName());
  if (QelRovFacetGroup* group = GiveExistingFacetGroupOfEditor(editor)) {
    if (setting != 1)
      group->ClosePanel();
    else if (group->IsPanelInitialized())
      group->RefreshPanel();
    else
      // Closed when a workbench without the panel was entered: a refresh alone would
      // leave the panel away for good.
      group->CreatePanel();
    return;
  }
  if (setting != 1) return;
  QelRovFacetGroup* group = InitFacetGroupOfEditor(editor);
  if (!group) return QelAssertPointer("QelRovFacetGroup");
  group->CreatePanel();
}

void QelRovFacetController::OnSettingModified(QelBaseUnknown* notification) {
  if (!notification || !repository_) return QelAssertPointer(notification ? "QelSettingRepository" : "notification");
  auto* setting = QelSysDynamicCast<QelSettingNotif>(notification);
  if (!setting) return;
  std::string key = setting->GetName().CastToCharPtr();
  if (key.empty()) {
    QelFrmContext* context = QelFrmContext::GetContext();
    if (!context) return QelAssertPointer("QelFrmContext");
    key = KeyOf(context->GetWorkbenchName()).CastToCharPtr();
  } else if (const size_t tab = key.find('\t'); tab != std::string::npos) {
    key.erase(tab);
  }
  int value = 0;
  repository_->ReadSetting(key.c_str(), &value, 1);
  QelFrmEditor* editor = QelFrmEditor::GetCurrentEditor();
  if (!editor) return QelAssertPointer("QelFrmEditor");
  if (value != 0)
    CreateDataFilteringPanel(editor);
  else
    DestroyDataFilteringPanel(editor);
}
