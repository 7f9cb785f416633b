#include "QelDbrBrowser.h"

#include "QelAssert.h"
#include "QelCallbackManager.h"
#include "QelFrmEditor.h"
#include "QelIDbrBrowserContextFactory.h"
#include "QelIDbrBrowserViewBaseUI.h"
#include "QelIVIABaseUI.h"
#include "QelListValQelUnicodeString.h"
#include "QelMetaObject.h"

const QelMetaObject& QelDbrBrowser::MetaObject() {
  static const QelMetaObject& meta = QelMetaObject::Declare("QelDbrBrowser", QelMetaKind::Implementation,
                                                            &QelBaseUnknown::MetaObject(), "QelReviewFramework");
  return meta;
}

QelDbrBrowser::QelDbrBrowser(int browserType, QelPathElement* rootPath, QelBaseUnknown* previewViewer)
    : type_(browserType),
      rootPath_(QelVar<QelPathElement>::Retain(rootPath)),
      previewViewer_(previewViewer) {}

QelDbrBrowser::~QelDbrBrowser() {
  StopFollowing();
  DetachItems();
  // The context is let go without a reset (Close is the orderly way), so a context must
  // survive being dropped unreset.
  context_ = nullptr;
}

void QelDbrBrowser::DetachItems() {
  // An item keeps the root path it was given, and the root path holds the model's root,
  // which owns the item: the loop is broken when the browser stops showing the item.
  for (const Node& node : nodes_)
    for (const auto& item : node.items)
      if (QelVar<QelIDbrBrowserViewBaseUI> ui{item.get()}) ui->SetRootPath(nullptr);
  nodes_.clear();
}

void* QelDbrBrowser::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelIDbrBrowser, QelIDbrBrowserView>(this, iid)) return mine;
  return QelBaseUnknown::QueryDirect(iid);
}

HRESULT QelDbrBrowser::Open(QelBaseUnknown* object, QelFrmEditor* editor) {
  Close();
  QelVar<QelIDbrBrowserContextFactory> factory{object};
  if (!factory) return E_FAIL;
  int type = type_;
  if (!factory->IsBrowserAvailable(type)) return S_FALSE;
  QelBaseUnknown_var self(static_cast<QelIDbrBrowser*>(this));
  QelBaseUnknown_var made = factory->GetBrowserContext(type, self);
  context_ = QelVar<QelIDbrBrowserContext>(made.get());
  if (!context_) return E_FAIL;
  context_->InitContents(nullptr);
  editor_ = QelBaseUnknown_WR(editor);
  if (editor) {
    QelCallbackManager::Get().AddCallback(editor, kQelUIActiveObjectChanged, static_cast<QelIDbrBrowser*>(this),
                                          [this](QelBaseUnknown*, QelBaseUnknown*) { FollowUIActiveObject(); });
  }
  if (Refresh() != S_OK) return E_FAIL;
  // Opened while another product is UI-active, the browser shows that product's sets at once.
  QelBaseUnknown_var active = editor && editor->GetUIActivePath() ? editor->GetUIActivePath()->GetLeaf() : nullptr;
  if (active && !active->IsEqual(object)) FollowUIActiveObject();
  return S_OK;
}

HRESULT QelDbrBrowser::Close() {
  StopFollowing();
  if (!context_) return S_FALSE;
  context_->ResetContents(nullptr);
  context_ = nullptr;
  DetachItems();
  return S_OK;
}

void QelDbrBrowser::StopFollowing() {
  if (QelBaseUnknown_var editor = editor_.Get())
    QelCallbackManager::Get().RemoveCallbacksOn(editor.get(), static_cast<QelIDbrBrowser*>(this));
  editor_.Reset();
}

void QelDbrBrowser::FollowUIActiveObject() {
  QelBaseUnknown_var editorObject = editor_.Get();
  auto* editor = QelSysDynamicCast<QelFrmEditor>(editorObject.get());
  if (!editor || !context_) return;
  QelVar<QelIDbrBrowserContext> context = context_;  // the context may empty the browser
  QelBaseUnknown_var active = editor->GetUIActivePath()->GetLeaf();
  context->ChangeContextObject(active);
}

std::vector<QelString> QelDbrBrowser::GetColumns(QelListValQelUnicodeString& headers) const {
  std::vector<QelString> columns;
  if (context_) context_->GetColumns(type_, columns, headers);
  return columns;
}

HRESULT QelDbrBrowser::Refresh() {
  DetachItems();
  if (!context_) return S_FALSE;
  std::vector<QelString> names;
  if (context_->ListNodeNames(type_, names) != S_OK) return E_FAIL;
  QelBaseUnknown_var self(static_cast<QelIDbrBrowserView*>(this));
  for (const QelString& name : names) {
    Node node{name, {}};
    context_->ListNodeItems(name, node.items);
    for (const auto& item : node.items) {
      QelVar<QelIDbrBrowserViewBaseUI> ui{item.get()};
      if (!ui) continue;
      ui->SetBrowserView(self);
      ui->SetRootPath(rootPath_.get());
    }
    nodes_.push_back(std::move(node));
  }
  return S_OK;
}

HRESULT QelDbrBrowser::OnContextEmptied() {
  ++emptied_;
  DetachItems();
  return S_OK;
}

HRESULT QelDbrBrowser::OnContextObjectChanged() {
  ++rebuilds_;
  return Refresh();
}

HRESULT QelDbrBrowser::OnContentsRebuilt() {
  ++rebuilds_;
  return Refresh();
}

HRESULT QelDbrBrowser::Activate(QelBaseUnknown* item) {
  QelVar<QelIVIABaseUI> ui{item};
  if (!ui) return E_FAIL;
  QelBaseUnknown_var editorObject = editor_.Get();
  // Chosen afresh even when it is already selected: activating changes the display, and
  // whoever follows the selection must hear of it again.
  if (auto* editor = QelSysDynamicCast<QelFrmEditor>(editorObject.get())) {
    editor->SetSelection(nullptr);
    editor->SetSelection(item);
  }
  return ui->ActivateItem();
}

QelPathElement* QelDbrBrowser::GetRootPath() {
  if (!rootPath_) return nullptr;
  rootPath_->AddRef();
  return rootPath_.get();
}

QelBaseUnknown_var QelDbrBrowser::GetPreviewViewer(int which) { return which == 0 ? previewViewer_ : nullptr; }

HRESULT QelDbrBrowser::BeginPreview() {
  if (inPreview_) {
    QelAssertBool("preview begun twice");
    return E_UNEXPECTED;
  }
  inPreview_ = true;
  ++previews_;
  return S_OK;
}

HRESULT QelDbrBrowser::EndPreview() {
  if (!inPreview_) return S_FALSE;
  inPreview_ = false;
  return S_OK;
}
