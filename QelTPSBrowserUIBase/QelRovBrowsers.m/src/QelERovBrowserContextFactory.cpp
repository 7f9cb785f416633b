#include "QelERovBrowserContextFactory.h"

#include <cstdlib>

#include "QelAssert.h"
#include "QelDbrBrowserContextLFT.h"
#include "QelFrmEditor.h"
#include "QelFrmLayout.h"
#include "QelMetaObject.h"
#include "QelRecord.h"
#include "QelRovBrowsersFactories.h"
#include "QelRovFacetServices.h"

namespace {
constexpr int kLightBrowserType = 1;
}  // namespace

const QelMetaObject& QelERovBrowserContextFactory::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelERovBrowserContextFactory", QelMetaKind::DataExtension, &QelBaseUnknown::MetaObject(),
                             "QelTPSBrowserUIBase", {"SorOccurrence", "PCCMemDMUValidationValidation"});
  return meta;
}

const QelMetaObject* QelERovBrowserContextFactory::GetMetaObject() const { return &MetaObject(); }

QelBaseUnknown* QelERovBrowserContextFactory::Create(QelBaseUnknown*) { return new QelERovBrowserContextFactory; }

void* QelERovBrowserContextFactory::QueryDirect(const QelIID& iid) {
  if (void* mine = QelQueryDirect<QelIDbrBrowserContextFactory>(this, iid)) return mine;
  return QelBaseUnknown::QueryDirect(iid);
}

bool QelERovBrowserContextFactory::IsBrowserAvailable(int& browserType) {
  if (browserType != kLightBrowserType) return false;
  QelFrmLayout* layout = QelFrmLayout::GetCurrentLayout();
  QelFrmWindow* window = layout ? layout->GetCurrentWindow() : nullptr;
  if (!window) {
    QelAssertPointer();
    return false;
  }
  // A recorded session replays clicks against window contents the browser would change;
  // "Qel_VB_LA" (set to any value, the empty one too) lets it open all the same.
  if (QelRecord* recorder = QelRecord::GetMain(); recorder && (recorder->IsCapture() || recorder->IsReplay()))
    if (!std::getenv("Qel_VB_LA")) return false;
  return !window->IsAKindOf("Qel2DLWindow");
}

QelBaseUnknown_var QelERovBrowserContextFactory::GetBrowserContext(int& browserType, QelBaseUnknown_var& browser) {
  if (browserType != kLightBrowserType) {
    QelAssertBool();
    return nullptr;
  }
  QelBaseUnknown_var root;
  QelRovFacetServices::GetRootPLMObject(QelFrmEditor::GetCurrentEditor(), root);
  if (!root) return nullptr;
  QelBaseUnknown_var context = context_.Get();
  if (!context) {
    // The creation reference moves into the answer: the browser's hold is the only one.
    context = QelMakeVar<QelDbrBrowserContextLFT>(root.get());
    context_ = QelBaseUnknown_WR(context.get());
  }
  auto* light = QelSysDynamicCast<QelDbrBrowserContextLFT>(context.get());
  if (!light) {
    QelAssertPointer();
    return nullptr;
  }
  light->SetBrowser(browserType, browser.get());
  return context;
}

extern "C" QelBaseUnknown* CreateBOAQelIDbrBrowserContextFactoryQelERovBrowserContextFactory(QelBaseUnknown* impl) {
  if (impl) impl->AddRef();
  return impl;
}
