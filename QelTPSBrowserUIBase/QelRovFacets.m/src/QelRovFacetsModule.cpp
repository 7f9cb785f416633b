// Load-time entry of the module. Registration of the module's classes runs here, once,
// from the one initialiser below, in the order the host expects; entries for classes
// still to come take their place in that order as they arrive.
#include "QelDbrBrowserContextLFT.h"
#include "QelDelayedDestruction.h"
#include "QelDictionary.h"
#include "QelERovBrowserContextFactory.h"
#include "QelERovViewsBrowserViewBaseUI.h"
#include "QelIDbrBrowserContext.h"
#include "QelIDbrBrowserContextFactory.h"
#include "QelIDbrBrowserViewBaseUI.h"
#include "QelIHyxFacetCtrl.h"
#include "QelILumCapture.h"
#include "QelILumGeometry.h"
#include "QelILumLightLoadModeObservable.h"
#include "QelILumLightLoadModeObserver.h"
#include "QelILumSet.h"
#include "QelInterfaceDescription.h"
#include "QelIRovFacetPropertyObserver.h"
#include "QelITPS.h"
#include "QelITPSExtractionView.h"
#include "QelITPSLight.h"
#include "QelITPSLightSet.h"
#include "QelITPSView.h"
#include "QelIVIABaseUI.h"
#include "QelModuleVersion.h"
#include "QelRovBrowsersFactories.h"
#include "QelRovFacet.h"
#include "QelRovFacetAnnotation.h"
#include "QelRovFacetAnnotationSet.h"
#include "QelRovFacetController.h"
#include "QelRovFacetGroup.h"
#include "QelRovFacetProperty.h"
#include "QelRovFacetPropertyGroup.h"
#include "QelRovFacetPropertyItem.h"
#include "QelRovFacetsFactories.h"
#include "QelRovFacetView.h"
#include "QelRovRefinementDlgSYPIntro.h"
#include "QelRovRefinementFacetSYPIntro.h"
#include "QelRovRefinementPropertySYPIntro.h"
#include "QelSYPMetaClassBuilder.h"

// The controller answers QelIHyxFacetCtrl itself; it is only ever made by name.
extern "C" QelBaseUnknown* CreateBOAQelIHyxFacetCtrlQelRovFacetController(QelBaseUnknown* impl) {
  if (impl) impl->AddRef();
  return impl;
}

extern "C" const char* QelRovFacetsModuleName() { return "QelRovFacets"; }

namespace {
constexpr const char* kFramework = "QelTPSBrowserUIBase";

template <class I>
void DescribeInterface(const char* name) {
  QelInterfaceDescription::Declare(name, I::IID, kFramework);
}

void QelRovFacetsRegister() {
  QelDictionary& dictionary = QelDictionary::Get();

  // The views browser: the light context, the context factory on occurrences and DMU
  // validations, the item adapter on light views and captures.
  const char* lightContext = QelDbrBrowserContextLFT::MetaObject().Name();
  dictionary.Register(lightContext, QelIDbrBrowserContext::IID,
                      &CreateTIEQelIDbrBrowserContextQelDbrBrowserContextLFT, kFramework);
  dictionary.Register(lightContext, QelILumLightLoadModeObserver::IID,
                      &CreateTIEQelILumLightLoadModeObserverQelDbrBrowserContextLFT, kFramework);
  const QelMetaObject& factory = QelERovBrowserContextFactory::MetaObject();
  for (const std::string& lateType : factory.LateTypes())
    dictionary.RegisterExtension(lateType, factory, &QelERovBrowserContextFactory::Create, kFramework);
  dictionary.Register(factory.Name(), QelIDbrBrowserContextFactory::IID,
                      &CreateBOAQelIDbrBrowserContextFactoryQelERovBrowserContextFactory, kFramework);
  const QelMetaObject& itemUI = QelERovViewsBrowserViewBaseUI::MetaObject();
  for (const std::string& lateType : itemUI.LateTypes())
    dictionary.RegisterExtension(lateType, itemUI, &QelERovViewsBrowserViewBaseUI::Create, kFramework);
  dictionary.Register(itemUI.Name(), QelIDbrBrowserViewBaseUI::IID,
                      &CreateTIEQelIDbrBrowserViewBaseUIQelERovViewsBrowserViewBaseUI, kFramework);
  dictionary.Register(itemUI.Name(), QelIVIABaseUI::IID, &CreateTIEQelIVIABaseUIQelERovViewsBrowserViewBaseUI,
                      kFramework);

  QelRovFacet::MetaObject();
  QelRovFacetProperty::MetaObject();
  QelRovFacetPropertyItem::MetaObject();

  // The facet controller: made by name, answering QelIHyxFacetCtrl itself. Its exit
  // action is the loader's destructor below.
  dictionary.RegisterNamedCreator(QelRovFacetController::ClassName(), &QelRovFacetController::Create, kFramework);
  dictionary.Register(QelRovFacetController::ClassName(), QelIHyxFacetCtrl::IID,
                      &CreateBOAQelIHyxFacetCtrlQelRovFacetController, kFramework);

  // The facet group.
  dictionary.Register(QelRovFacetGroup::MetaObject().Name(), QelIRovFacetPropertyObserver::IID,
                      &CreateTIEQelIRovFacetPropertyObserverQelRovFacetGroup, kFramework);
  dictionary.Register(QelRovFacetGroup::MetaObject().Name(), QelILumLightLoadModeObserver::IID,
                      &CreateTIEQelILumLightLoadModeObserverQelRovFacetGroup, kFramework);

  // The three facets, each the observer of its top-level properties.
  dictionary.Register(QelRovFacetAnnotation::MetaObject().Name(), QelIRovFacetPropertyObserver::IID,
                      &CreateTIEQelIRovFacetPropertyObserverQelRovFacetAnnotation, kFramework);
  dictionary.Register(QelRovFacetAnnotationSet::MetaObject().Name(), QelIRovFacetPropertyObserver::IID,
                      &CreateTIEQelIRovFacetPropertyObserverQelRovFacetAnnotationSet, kFramework);
  dictionary.Register(QelRovFacetView::MetaObject().Name(), QelIRovFacetPropertyObserver::IID,
                      &CreateTIEQelIRovFacetPropertyObserverQelRovFacetView, kFramework);

  // The property group.
  dictionary.Register(QelRovFacetPropertyGroup::MetaObject().Name(), QelIRovFacetPropertyObserver::IID,
                      &CreateTIEQelIRovFacetPropertyObserverQelRovFacetPropertyGroup, kFramework);

  // The interfaces: the module's own, then the host's that it queries or implements.
  DescribeInterface<QelIRovFacetPropertyObserver>("QelIRovFacetPropertyObserver");
  DescribeInterface<QelITPSView>("QelITPSView");
  DescribeInterface<QelITPS>("QelITPS");
  DescribeInterface<QelILumSet>("QelILumSet");
  DescribeInterface<QelILumCapture>("QelILumCapture");
  DescribeInterface<QelITPSExtractionView>("QelITPSExtractionView");
  DescribeInterface<QelILumGeometry>("QelILumGeometry");
  DescribeInterface<QelILumLightLoadModeObservable>("QelILumLightLoadModeObservable");
  DescribeInterface<QelITPSLightSet>("QelITPSLightSet");
  DescribeInterface<QelILumLightLoadModeObserver>("QelILumLightLoadModeObserver");
  DescribeInterface<QelITPSLight>("QelITPSLight");

  // The introspection builders of the panel widgets.
  QelSYPMetaClassBuilder::Register("QelRovRefinementDlgSYPMetaClassBuilder",
                                   &fctCreateQelRovRefinementDlgSYPMetaClassBuilder, kFramework);
  QelSYPMetaClassBuilder::Register("QelRovRefinementFacetSYPMetaClassBuilder",
                                   &fctCreateQelRovRefinementFacetSYPMetaClassBuilder, kFramework);
  QelSYPMetaClassBuilder::Register("QelRovRefinementPropertySYPMetaClassBuilder",
                                   &fctCreateQelRovRefinementPropertySYPMetaClassBuilder, kFramework);
}

// Registers at load and takes every entry back at unload, so that no dictionary entry
// outlives the factories it points into.
struct QelRovFacetsLoader {
  QelRovFacetsLoader() { QelRovFacetsRegister(); }
  ~QelRovFacetsLoader() {
    QelRovFacetController::ReleaseAtUnload();
    // Panels and dialogs queued for release run the module's code: they go before it does.
    while (QelDelayedDestruction::PendingCount() > 0) QelDelayedDestruction::FlushIdle();
    QelDictionary::Get().RemoveFramework(kFramework);
    QelSYPMetaClassBuilder::RemoveFramework(kFramework);
  }
};
const QelRovFacetsLoader g_loader;
}  // namespace
