#pragma once
// QelRovFacetController: the one process-wide controller of the data filtering panels. It
// keeps one facet group per editor (the list holds the only reference), follows the
// host's editors, windows, workbenches and the per-workbench setting, and opens, refreshes
// or closes each editor's panel through its group. Made by the component
// "QelRovFacetController"; the module releases it when it is unloaded.
#include "QelCallbackManager.h"
#include "QelIHyxFacetCtrl.h"
#include "QelListValQelBaseUnknown_var.h"
#include "QelMetaObject.h"
#include "QelRovFacetsExport.h"
#include "QelString.h"

class QelFrmEditor;
class QelRovFacetGroup;
class QelSettingRepository;

class QEL_ROV_EXPORT QelRovFacetController : public QelIHyxFacetCtrl {
 public:
  static const char* ClassName();
  // The class's identifier in the component framework: its meta class's name.
  static const char* ClassId();
  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  // The named creation function: the process-wide controller with a new reference, made
  // on first use; null when the refinement switch is off.
  static QelBaseUnknown* Create();
  // What the meta class creates: the process-wide controller again, never a second one.
  static QelBaseUnknown* CreateItself();
  // The exit action of the module: ends the subscriptions and drops the process-wide
  // controller (and with it every group and panel).
  static void ReleaseAtUnload();
  // Borrowed; null when none was made.
  static QelRovFacetController* GetDataFilterController();

  // QelIHyxFacetCtrl.
  void CreateDataFilteringPanelIfNecessary() override;
  void CloseDataFilteringPanel() override;

  QelRovFacetGroup* InitFacetGroupOfEditor(QelFrmEditor* editor);
  QelRovFacetGroup* GiveExistingFacetGroupOfEditor(QelFrmEditor* editor) const;
  void RefreshDataFilteringPanel(QelFrmEditor* editor);
  static HRESULT HideDataFilteringPanel(QelFrmEditor* editor);
  static HRESULT RestoreDataFilteringPanel(QelFrmEditor* editor);
  bool IsDataFilteringPanelInitialized(QelFrmEditor* editor) const;
  void RemoveCallbacks();

  // The stored value for workbench `workbench`: 0 outside the three workbenches that have
  // the panel, when the key is absent, or without a repository.
  int ReadDataFilteringPanelSetting(QelString workbench) const;
  int GetGroupCount() const { return groups_.Size(); }
  bool IsWaitingForWindow() const { return windowSubscription_ != 0; }

  // Notification handlers.
  void OnEditorClosed(QelBaseUnknown* editor);
  void OnSettingModified(QelBaseUnknown* notification);
  void OnUIActiveObjectChanged();
  void OnWindowActivated();
  void OnWorkbenchChanged();

  // Hosts obtain the controller through Create; one made here is not the process-wide one.
  QelRovFacetController();

 protected:
  ~QelRovFacetController() override;
  void* QueryDirect(const QelIID& iid) override;

 private:
  void CreateDataFilteringPanel(QelFrmEditor* editor);
  void DestroyDataFilteringPanel(QelFrmEditor* editor);
  static HRESULT ShowPanelOf(QelFrmEditor* editor, bool show);

  QelListValQelBaseUnknown_var groups_;
  QelCallbackId editorCloseSubscription_ = 0;
  QelCallbackId activeObjectSubscription_ = 0;
  QelCallbackId workbenchSubscription_ = 0;
  QelCallbackId settingSubscription_ = 0;
  QelCallbackId windowSubscription_ = 0;
  QelSettingRepository* repository_ = nullptr;  // lent by the settings service
};
