#pragma once
// QelHostPictures: qelhost's one-shot picture options. `--thumbnail NAME --output FILE`
// (repeatable; NAME "*" writes every view and capture into the folder FILE) writes the
// plug-in's thumbnail of a view or capture as PNG and prints its description;
// `--picture FILE` writes the 3D viewer's picture of the whole model.
#include <string>
#include <vector>

namespace QelHostPictures {
// True when `args` ask for pictures; then `exitCode` is what qelhost returns.
bool Run(const std::vector<std::string>& args, const std::string& modulePath, const std::string& sampleText,
         const std::string& sampleName, int& exitCode);
}  // namespace QelHostPictures
