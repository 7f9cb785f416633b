#pragma once
// QelHostPictures: qelhost's one-shot picture options. `--thumbnail NAME --output FILE`
// (repeatable; NAME "*" writes every view and capture into the folder FILE) writes the
// plug-in's thumbnail of a view or capture as PNG and prints its description;
// `--picture FILE` writes the 3D viewer's picture of the whole model.
#include <string>
#include <vector>

#include "Qel3DViewer.h"

namespace QelHostPictures {
// The session's picture commands, for a model `root` shown by `viewer`. `module` is the
// loaded plug-in (its toolbox makes the thumbnails). Each prints what it wrote, or why
// not on stderr, and answers the number of pictures that could not be written.
int WriteThumbnails(void* module, QelBaseUnknown* root, const std::string& name, const std::string& output);
// `keepViewpoint`: draw from the viewer's viewpoint as it is (a capture's, after an
// activation) instead of the whole model from above and aside.
int WritePicture(QelBaseUnknown* root, Qel3DViewer* viewer, const std::string& file, bool keepViewpoint = false);

// Looks up a function the plug-in exports by its (mangled) name; false, with the loader's
// reason on stderr, when the module has no such export.
bool FindExportedAddress(void* module, const char* name, void*& address);
template <class F>
bool FindExport(void* module, const char* name, F& function) {
  void* address = nullptr;
  if (!FindExportedAddress(module, name, address)) return false;
  function = reinterpret_cast<F>(address);
  return true;
}

// True when `args` ask for pictures; then `exitCode` is what qelhost returns.
bool Run(const std::vector<std::string>& args, const std::string& modulePath, const std::string& sampleText,
         const std::string& sampleName, int& exitCode);
}  // namespace QelHostPictures
