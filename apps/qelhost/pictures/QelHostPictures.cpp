#include "QelHostPictures.h"

#include <dlfcn.h>

#include <cctype>
#include <cstdio>
#include <filesystem>
#include <iostream>

#include "Qel3DViewer.h"
#include "Qel3DWindow.h"
#include "QelAnnotationComponents.h"
#include "QelApplicationFrame.h"
#include "QelDelayedDestruction.h"
#include "QelFrmLayout.h"
#include "QelIBuildPath.h"
#include "QelILumCapture.h"
#include "QelILumSetComponent.h"
#include "QelITPSView.h"
#include "QelHostModelFiles.h"
#include "QelModelLoader.h"
#include "QelModelObject.h"
#include "QelUnicodeString.h"
#include "QelModelPrinter.h"
#include "QelModelScene.h"
#include "QelModuleLoader.h"
#include "QelOffscreenSupport.h"
#include "QelPngWriter.h"
#include "QelReviewFramework.h"
#include "QelRovActivateAndDisplayToolbox.h"
#include "QelRovFacetServices.h"

namespace {
// The toolbox is exported by the plug-in as a C++ class; the host never links the plug-in,
// so it looks the two public operations up by their exported names.
using PreviewFn = QelPixelImage* (*)(QelBaseUnknown_var&, Qel3DViewer*, QelPathElement*);
using DescriptionFn = QelUnicodeString (*)(QelBaseUnknown_var&);
constexpr const char* kPreviewSymbol =
    "_ZN24QelRovBrowserViewToolbox19GetThumbnailPreviewER6QelVarI14QelBaseUnknownEP11Qel3DViewerP14QelPathElement";
constexpr const char* kDescriptionSymbol =
    "_ZN24QelRovBrowserViewToolbox23GetThumbnailDescriptionER6QelVarI14QelBaseUnknownE";

struct Request {
  std::string name;
  std::string output;
};

std::string FileNameFor(const std::string& alias) {
  std::string name;
  for (char c : alias) name += (std::isalnum(static_cast<unsigned char>(c)) || c == '-' || c == '.') ? c : '_';
  return name + ".png";
}

bool WriteThumbnail(QelBaseUnknown* root, QelBaseUnknown* item, Qel3DViewer* viewer, const std::string& file,
                    PreviewFn preview, DescriptionFn describe) {
  QelBaseUnknown_var handle = QelBaseUnknown_var::Retain(item);
  // The root path, as the views browser gives its items: the toolbox builds the item's own
  // path under it, so both draw the same picture.
  auto context = QelMakeVar<QelPathElement>();
  context->AddChildElement(root);
  QelVar<QelPixelImage> image = QelVar<QelPixelImage>::Adopt(preview(handle, viewer, context.get()));
  if (!image) {
    std::fprintf(stderr, "qelhost: no thumbnail could be made for '%s'\n", QelModelObject::From(item)->Alias().c_str());
    return false;
  }
  std::string error;
  if (!QelPngWriter::Write(*image, file, error)) {
    std::fprintf(stderr, "qelhost: %s\n", error.c_str());
    return false;
  }
  QelUnicodeString description = describe(handle);
  std::printf("thumbnail '%s' -> %s (%d x %d): %s\n", QelModelObject::From(item)->Alias().c_str(), file.c_str(),
              image->GetWidth(), image->GetHeight(),
              description.GetLengthInChar() ? description.Utf8().c_str() : "(no description)");
  return true;
}

int Produce(const std::vector<Request>& thumbnails, const std::vector<std::string>& pictures,
            const std::string& modelPath, const std::string& modulePath, const std::string& sampleText,
            const std::string& sampleName) {
  std::string error;
  QelBaseUnknown_var root;
  if ((modelPath.empty() ? QelModelLoader::LoadText(sampleText, sampleName, root, error)
                         : QelHostModelFiles::Load(modelPath, root, error, std::cout)) != S_OK) {
    std::fprintf(stderr, "qelhost: %s\n", error.c_str());
    return 1;
  }
  QelReviewFramework::Register();
  QelApplicationFrame* frame = QelApplicationFrame::CreateFrame("LumReview");
  auto editor = QelMakeVar<QelFrmEditor>(root.get());
  auto window = QelMakeVar<Qel3DWindow>(editor.get());
  auto viewer = QelMakeVar<Qel3DViewer>(800, 600);
  viewer->SetSceneSource(QelMakeVar<QelModelScene>(root.get()).get());
  window->SetViewer(viewer.get());
  frame->GetLayout()->AddWindow(window.get());
  frame->GetLayout()->SetCurrentWindow(window.get());
  int failures = 0;
  for (const std::string& file : pictures) failures += QelHostPictures::WritePicture(root.get(), viewer.get(), file);
  if (!thumbnails.empty()) {
    void* module = QelModuleLoader::Load(modulePath, error);
    if (!module) {
      std::fprintf(stderr, "qelhost: %s\n", error.c_str());
      ++failures;
    } else {
      for (const Request& request : thumbnails)
        failures += QelHostPictures::WriteThumbnails(module, root.get(), request.name, request.output);
    }
  }
  window->SetViewer(nullptr);
  QelApplicationFrame::DestroyFrame();
  QelDelayedDestruction::FlushIdle();
  return failures ? 1 : 0;
}
}  // namespace

int QelHostPictures::WritePicture(QelBaseUnknown* root, Qel3DViewer* viewer, const std::string& file,
                                  bool keepViewpoint) {
  Qel3DViewpoint* viewpoint = viewer->GetMain3DViewpoint();
  viewer->PrepareViewpoint();
  if (!keepViewpoint) {
    viewpoint->SetOrientation(QelMathDirectionf(QelMathVector{-1, 1.5, -1}), QelMathDirectionf(QelMathVector{0, 0, 1}));
    auto path = QelMakeVar<QelPathElement>();
    path->AddChildElement(root);
    QelRovActivateAndDisplayToolbox::ReframeViewpointOnDisplayArea(path.get(), viewer, viewpoint);
  }
  QelSupport* support = viewer->GetSupport();
  auto image = QelMakeVar<QelPixelImage>(support->GetWidth(), support->GetHeight());
  QelVar<QelOffscreenSupport> offscreen = createSupport(support, image.get());
  if (!offscreen) {
    std::fprintf(stderr, "qelhost: %s: the viewer has no surface to draw\n", file.c_str());
    return 1;
  }
  offscreen->SetBackgroundColor(0.5f, 0.5f, 0.5f);
  offscreen->SetTextSprites(1);
  offscreen->Draw();
  std::string error;
  if (!QelPngWriter::Write(*image, file, error)) {
    std::fprintf(stderr, "qelhost: %s\n", error.c_str());
    return 1;
  }
  std::printf("picture -> %s (%d x %d)\n", file.c_str(), image->GetWidth(), image->GetHeight());
  // A shown annotation whose label found no room keeps its mark; the person is told which.
  const std::vector<std::string>& unplaced = offscreen->GetUnplacedLabels();
  if (!unplaced.empty()) {
    std::string names;
    for (const std::string& name : unplaced) names += (names.empty() ? "" : ", ") + name;
    std::printf("  %zu label(s) not placed, marks only: %s\n", unplaced.size(), names.c_str());
  }
  return 0;
}


bool QelHostPictures::FindExportedAddress(void* module, const char* name, void*& address) {
  dlerror();  // a stale error would be taken for this look-up's
  address = dlsym(module, name);
  if (const char* why = dlerror()) {
    std::fprintf(stderr, "qelhost: %s\n", why);
    address = nullptr;
  }
  return address != nullptr;
}

int QelHostPictures::WriteThumbnails(void* module, QelBaseUnknown* root, const std::string& name,
                                     const std::string& output) {
  PreviewFn preview = nullptr;
  DescriptionFn describe = nullptr;
  if (!module || !QelHostPictures::FindExport(module, kPreviewSymbol, preview) ||
      !QelHostPictures::FindExport(module, kDescriptionSymbol, describe)) {
    std::fprintf(stderr, "qelhost: the plug-in exports no thumbnail toolbox\n");
    return 1;
  }
  std::vector<std::pair<QelBaseUnknown_var, std::string>> jobs;
  if (name == "*") {
    std::error_code ec;
    std::filesystem::create_directories(output, ec);
    if (ec) {
      std::fprintf(stderr, "qelhost: %s: %s\n", output.c_str(), ec.message().c_str());
      return 1;
    }
    QelListValQelBaseUnknown_var items;
    QelRovFacetServices::ListCapturesAndViewsOfVisibleSets(root, items);
    for (int i = 1; i <= items.Size(); ++i)
      jobs.emplace_back(items[i], (std::filesystem::path(output) /
                                   FileNameFor(QelModelObject::From(items[i].get())->Alias())).string());
  } else {
    QelListValQelBaseUnknown_var found = QelModelPrinter::FindByAlias(root, name);
    QelBaseUnknown_var item;
    for (int i = 1; i <= found.Size() && !item; ++i)
      if (QelVar<QelITPSView>(found[i].get()) || QelVar<QelILumCapture>(found[i].get())) item = found[i];
    if (!item) {
      std::fprintf(stderr, "qelhost: thumbnail '%s': the model has no view or capture of that name\n", name.c_str());
      return 1;
    }
    jobs.emplace_back(item, output);
  }
  // Previews are drawn by a viewer of their own, as the views browser does, so the
  // session's 3D viewer keeps its viewpoint; the current window's view modes are copied.
  auto viewer = QelMakeVar<Qel3DViewer>(576, 432);
  viewer->SetSceneSource(QelMakeVar<QelModelScene>(root).get());
  int failures = 0;
  for (size_t i = 0; i < jobs.size(); ++i) {
    if (jobs.size() > 1) std::printf("[%zu/%zu] ", i + 1, jobs.size());
    failures += WriteThumbnail(root, jobs[i].first.get(), viewer.get(), jobs[i].second, preview, describe) ? 0 : 1;
    std::fflush(stdout);
  }
  return failures;
}

bool QelHostPictures::Run(const std::vector<std::string>& args, const std::string& modulePath,
                          const std::string& sampleText, const std::string& sampleName, int& exitCode) {
  bool asked = false;
  for (const auto& a : args) asked = asked || a == "--thumbnail" || a == "--picture";
  if (!asked) return false;
  std::vector<Request> thumbnails;
  std::vector<std::string> pictures;
  std::string model, module = modulePath;
  exitCode = 2;
  for (size_t i = 0; i < args.size(); ++i) {
    const std::string& a = args[i];
    auto value = [&](const char* what) -> const std::string* {
      if (i + 1 >= args.size()) {
        std::fprintf(stderr, "qelhost: %s needs %s\n", a.c_str(), what);
        return nullptr;
      }
      return &args[++i];
    };
    if (a == "--thumbnail") {
      const std::string* name = value("the name of a view or capture");
      if (!name) return true;
      thumbnails.push_back({*name, {}});
    } else if (a == "--output") {
      const std::string* file = value("a file name");
      if (!file) return true;
      if (thumbnails.empty() || !thumbnails.back().output.empty()) {
        std::fprintf(stderr, "qelhost: --output %s follows no --thumbnail\n", file->c_str());
        return true;
      }
      thumbnails.back().output = *file;
    } else if (a == "--picture") {
      const std::string* file = value("a file name");
      if (!file) return true;
      pictures.push_back(*file);
    } else if (a == "--module") {
      const std::string* file = value("a file name");
      if (!file) return true;
      module = *file;
    } else if (!a.empty() && a[0] != '-' && model.empty()) {
      model = a;
    } else {
      std::fprintf(stderr, "qelhost: '%s' cannot be used with --thumbnail or --picture\n", a.c_str());
      return true;
    }
  }
  for (const Request& r : thumbnails) {
    if (r.output.empty()) {
      std::fprintf(stderr, "qelhost: --thumbnail %s needs --output FILE\n", r.name.c_str());
      return true;
    }
  }
  exitCode = Produce(thumbnails, pictures, model, module, sampleText, sampleName);
  return true;
}
