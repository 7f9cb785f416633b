#include "QelCommandHeader.h"

#include <memory>
#include <vector>

namespace {
struct Entry {
  std::unique_ptr<QelCommandHeader> header;
  std::string framework;
};
std::vector<Entry>& Headers() {
  static std::vector<Entry> headers;
  return headers;
}
}  // namespace

void QelCommandHeader::Register(std::string_view name, Action action, std::string_view framework) {
  auto header = std::make_unique<QelCommandHeader>(std::string(name), std::move(action));
  for (auto& entry : Headers())
    if (entry.header->GetName() == name) {
      entry = {std::move(header), std::string(framework)};
      return;
    }
  Headers().push_back({std::move(header), std::string(framework)});
}

void QelCommandHeader::RemoveFramework(std::string_view framework) {
  std::erase_if(Headers(), [&](const Entry& entry) { return entry.framework == framework; });
}

QelCommandHeader* QelCommandHeader::GetHeaderFromList(const char* name, int list) {
  if (!name || list != 0) return nullptr;
  for (const auto& entry : Headers())
    if (entry.header->GetName() == name) return entry.header.get();
  return nullptr;
}

void QelCommandHeader::StartCommand() {
  ++starts_;
  // A copy: an action that re-registers its own header must not run from a freed one.
  Action action = action_;
  if (action) action();
}
