#pragma once
// QelCommandHeader: a named entry point of a command. The host registers each header once
// under its name; callers look it up by name and start it. Headers are not counted: they
// live until their framework is removed (or the process ends); GetHeaderFromList lends them.
#include <functional>
#include <string>
#include <string_view>

class QelCommandHeader {
 public:
  using Action = std::function<void()>;

  QelCommandHeader(std::string name, Action action) : name_(std::move(name)), action_(std::move(action)) {}

  // Registers (or replaces) the header of that name.
  static void Register(std::string_view name, Action action, std::string_view framework = {});
  static void RemoveFramework(std::string_view framework);
  // The header registered under `name`; borrowed, null when none. The second argument is
  // the host's list selector; only list 0 exists.
  static QelCommandHeader* GetHeaderFromList(const char* name, int list);

  const std::string& GetName() const { return name_; }
  // Runs the command; the number of runs is kept for a person (and a test) to see.
  void StartCommand();
  int GetStartCount() const { return starts_; }

 private:
  std::string name_;
  Action action_;
  int starts_ = 0;
};
