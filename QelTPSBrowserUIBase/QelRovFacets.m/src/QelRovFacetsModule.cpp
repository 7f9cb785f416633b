// Load-time entry of the module. Registration of the module's classes runs here, once,
// from the one initialiser below, in the order the host expects: per class its meta class
// then its dictionary entries, the controller's exit action and named creation function
// among them, then the introspection builders, then the interface descriptions.
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
#include "QelRovFacetAnnotation.h"
#include "QelRovFacetAnnotationSet.h"
#include "QelRovFacetController.h"
#include "QelRovFacetGroup.h"
#include "QelRovFacetPropertyGroup.h"
#include "QelRovFacetsFactories.h"
#include "QelRovFacetView.h"
#include "QelRovRefinementDlgSYPIntro.h"
#include "QelRovRefinementFacetSYPIntro.h"
#include "QelRovRefinementPropertySYPIntro.h"
#include "QelSYPMetaClassBuilder.h"

// The controller answers QelIHyxFacetCtrl itself; it is only ever made by name, so the
// direct factory hands back what it is given and creates nothing.
extern "C" QelBaseUnknown* CreateBOAQelIHyxFacetCtrlQelRovFacetController(QelBaseUnknown* impl) {
  if (impl) impl->AddRef();
  return impl;
}

extern "C" const char* QelRovFacetsModuleName() { return "QelRovFacets"; }
extern "C" const int QelModuleAbiVersion = kQelModuleAbiVersion;

namespace {
constexpr const char* kFramework = "QelTPSBrowserUIBase";

template <class I>
void DescribeInterface(const char* name) {
  QelInterfaceDescription::Declare(name, I::IID, kFramework);
}

template <class I>
void Enter(const QelMetaObject& meta, QelFactory factory) {
  QelDictionary::Get().Register(meta.Name(), I::IID, factory, kFramework);
}

// A data extension: its creator under each late type it extends, then its interface.
template <class I>
void EnterExtension(const QelMetaObject& meta, QelExtensionCreator creator, QelFactory factory) {
  for (const std::string& lateType : meta.LateTypes())
    QelDictionary::Get().RegisterExtension(lateType, meta, creator, kFramework);
  Enter<I>(meta, factory);
}

// Runs while the library is still mapped, before its entries leave the dictionary: the
// controller drops its host callbacks and its groups, and panels and dialogs queued for
// delayed destruction (whose destructors are the module's code) go now rather than later.
void ExitAction() {
  QelRovFacetController::ReleaseAtUnload();
  while (QelDelayedDestruction::PendingCount() > 0) QelDelayedDestruction::FlushIdle();
}

void QelRovFacetsRegister() {
  QelDictionary& dictionary = QelDictionary::Get();

  // The views browser: the light context, the context factory on occurrences and DMU
  // validations, the item adapter on light views and captures.
  const QelMetaObject& lightContext = QelDbrBrowserContextLFT::MetaObject();
  Enter<QelIDbrBrowserContext>(lightContext, &CreateTIEQelIDbrBrowserContextQelDbrBrowserContextLFT);
  Enter<QelILumLightLoadModeObserver>(lightContext, &CreateTIEQelILumLightLoadModeObserverQelDbrBrowserContextLFT);
  EnterExtension<QelIDbrBrowserContextFactory>(QelERovBrowserContextFactory::MetaObject(),
                                               &QelERovBrowserContextFactory::Create,
                                               &CreateBOAQelIDbrBrowserContextFactoryQelERovBrowserContextFactory);
  const QelMetaObject& itemUI = QelERovViewsBrowserViewBaseUI::MetaObject();
  EnterExtension<QelIDbrBrowserViewBaseUI>(itemUI, &QelERovViewsBrowserViewBaseUI::Create,
                                           &CreateTIEQelIDbrBrowserViewBaseUIQelERovViewsBrowserViewBaseUI);
  Enter<QelIVIABaseUI>(itemUI, &CreateTIEQelIVIABaseUIQelERovViewsBrowserViewBaseUI);

  // The annotation facet and the annotation set facet, observers of their properties.
  Enter<QelIRovFacetPropertyObserver>(QelRovFacetAnnotation::MetaObject(),
                                      &CreateTIEQelIRovFacetPropertyObserverQelRovFacetAnnotation);
  Enter<QelIRovFacetPropertyObserver>(QelRovFacetAnnotationSet::MetaObject(),
                                      &CreateTIEQelIRovFacetPropertyObserverQelRovFacetAnnotationSet);

  // The facet controller: its exit action, the creation function the host calls by
  // name, then QelIHyxFacetCtrl, which it answers itself.
  const QelMetaObject& controller = QelRovFacetController::MetaObject();
  dictionary.RegisterExitAction(&ExitAction, kFramework);
  dictionary.RegisterNamedCreator(controller.Name(), &QelRovFacetController::Create, kFramework);
  Enter<QelIHyxFacetCtrl>(controller, &CreateBOAQelIHyxFacetCtrlQelRovFacetController);

  const QelMetaObject& group = QelRovFacetGroup::MetaObject();
  Enter<QelIRovFacetPropertyObserver>(group, &CreateTIEQelIRovFacetPropertyObserverQelRovFacetGroup);
  Enter<QelILumLightLoadModeObserver>(group, &CreateTIEQelILumLightLoadModeObserverQelRovFacetGroup);

  Enter<QelIRovFacetPropertyObserver>(QelRovFacetPropertyGroup::MetaObject(),
                                      &CreateTIEQelIRovFacetPropertyObserverQelRovFacetPropertyGroup);
  Enter<QelIRovFacetPropertyObserver>(QelRovFacetView::MetaObject(),
                                      &CreateTIEQelIRovFacetPropertyObserverQelRovFacetView);

  // The introspection builders of the panel widgets.
  QelSYPMetaClassBuilder::Register("QelRovRefinementDlgSYPMetaClassBuilder",
                                   &fctCreateQelRovRefinementDlgSYPMetaClassBuilder, kFramework);
  QelSYPMetaClassBuilder::Register("QelRovRefinementFacetSYPMetaClassBuilder",
                                   &fctCreateQelRovRefinementFacetSYPMetaClassBuilder, kFramework);
  QelSYPMetaClassBuilder::Register("QelRovRefinementPropertySYPMetaClassBuilder",
                                   &fctCreateQelRovRefinementPropertySYPMetaClassBuilder, kFramework);

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
  // The host's interfaces it implements, so that a host lists the entries above by name.
  DescribeInterface<QelIDbrBrowserContext>("QelIDbrBrowserContext");
  DescribeInterface<QelIDbrBrowserContextFactory>("QelIDbrBrowserContextFactory");
  DescribeInterface<QelIDbrBrowserViewBaseUI>("QelIDbrBrowserViewBaseUI");
  DescribeInterface<QelIVIABaseUI>("QelIVIABaseUI");
  DescribeInterface<QelIHyxFacetCtrl>("QelIHyxFacetCtrl");
}

// Registers at load; at unload the dictionary runs the exit action and takes every entry
// back, so that no entry outlives the factories it points into.
struct QelRovFacetsLoader {
  QelRovFacetsLoader() { QelRovFacetsRegister(); }
  ~QelRovFacetsLoader() {
    QelDictionary::Get().RemoveFramework(kFramework);
    QelSYPMetaClassBuilder::RemoveFramework(kFramework);
  }
};
const QelRovFacetsLoader g_loader;
}  // namespace
