#pragma once
// QelInterfaceDescription: the process-wide record of an interface (name, identifier and
// the framework that describes it), declared by the modules that implement or query it so
// that identifiers can be shown by name. Declared once, never freed.
#include <string>
#include <string_view>

#include "QelIID.h"

class QelInterfaceDescription {
 public:
  // Declares the interface, or gives the existing record of that identifier.
  static const QelInterfaceDescription& Declare(std::string_view name, const QelIID& iid,
                                                std::string_view framework);
  static const QelInterfaceDescription* Find(const QelIID& iid);
  // The interface's name, or its identifier's text when nobody described it.
  static std::string NameOf(const QelIID& iid);

  const std::string& Name() const { return name_; }
  const QelIID& IID() const { return iid_; }
  const std::string& Framework() const { return framework_; }

  QelInterfaceDescription(std::string name, const QelIID& iid, std::string framework)
      : name_(std::move(name)), iid_(iid), framework_(std::move(framework)) {}

 private:
  std::string name_;
  QelIID iid_;
  std::string framework_;
};
