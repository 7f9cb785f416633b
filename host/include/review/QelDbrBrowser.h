#pragma once
// QelDbrBrowser: the host's review browser. Opened on an object, it asks that object's
// context factory for a context, holds it, and lists the context's nodes and, per node,
// its items; each item is told its browser view and root path. It follows the current
// editor's UI-active object while open. Close (or the last release) lets the context go.
#include <vector>

#include "QelDbrBrowserContext.h"
#include "QelIDbrBrowser.h"
#include "QelIDbrBrowserContext.h"
#include "QelIDbrBrowserView.h"

class QelFrmEditor;

class QelDbrBrowser : public QelIDbrBrowser, public QelIDbrBrowserView {
 public:
  struct Node {
    QelString name;
    QelListValQelBaseUnknown_var items;
  };

  // `rootPath` is the path items are shown under; `previewViewer` renders their previews.
  QelDbrBrowser(int browserType, QelPathElement* rootPath, QelBaseUnknown* previewViewer);

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

  // S_OK open; S_FALSE when the object's factory declines this browser type here; E_FAIL
  // when the object has no factory or gives no context. An open browser is closed first.
  HRESULT Open(QelBaseUnknown* object, QelFrmEditor* editor);
  // Resets and lets go of the context; S_FALSE when not open.
  HRESULT Close();
  bool IsOpen() const { return context_ != nullptr; }

  const std::vector<Node>& GetNodes() const { return nodes_; }
  // Column identifiers and headers of the context; empty when closed.
  std::vector<QelString> GetColumns(QelListValQelUnicodeString& headers) const;
  // The item's path for the browser, selected in the editor, then activated.
  HRESULT Activate(QelBaseUnknown* item);
  // Counts of the context's calls, for a person (and a test) to see what happened.
  int GetEmptiedCount() const { return emptied_; }
  int GetRebuildCount() const { return rebuilds_; }

  // QelIDbrBrowser
  int GetBrowserType() override { return type_; }
  QelBaseUnknown_var GetBrowserContext() override { return QelBaseUnknown_var(context_.get()); }
  HRESULT Refresh() override;
  HRESULT OnContextEmptied() override;
  HRESULT OnContextObjectChanged() override;
  HRESULT OnContentsRebuilt() override;
  // QelIDbrBrowserView
  QelPathElement* GetRootPath() override;
  QelBaseUnknown_var GetPreviewViewer(int which) override;
  int GetPreviewCount() override { return previews_; }
  HRESULT BeginPreview() override;
  HRESULT EndPreview() override;

 protected:
  ~QelDbrBrowser() override;
  void* QueryDirect(const QelIID& iid) override;

 private:
  void FollowUIActiveObject();
  void StopFollowing();
  void DetachItems();

  int type_;
  QelVar<QelPathElement> rootPath_;
  QelBaseUnknown_var previewViewer_;
  QelVar<QelIDbrBrowserContext> context_;
  QelBaseUnknown_WR editor_;
  std::vector<Node> nodes_;
  int emptied_ = 0;
  int rebuilds_ = 0;
  int previews_ = 0;
  bool inPreview_ = false;
};
