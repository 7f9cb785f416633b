#pragma once
// QelModelObject: what every object of a product model has in common: a display name
// (QelIAlias), an icon name (QelIIcon) and a shown or hidden state read and switched in
// O(1). Counted like every object; the model's owner links run downward only, so an
// object's links to its container are weak.
#include <string>

#include "QelIAlias.h"
#include "QelIIcon.h"

class QelRovFacetFilterData;

class QelModelObject : public QelIAlias, public QelIIcon {
 public:
  // Answered by every model object's own QueryDirect, so the services reach the model
  // object behind any handle without a cast through the virtual base.
  static constexpr QelIID ClassIID = QelIID::Parse("{6A3F0E52-9C1B-4D7E-8F20-4B5C6D7E8F91}");
  static QelModelObject* From(QelBaseUnknown* object) {
    QelBaseUnknown* impl = object ? object->GetImpl() : nullptr;
    return impl ? static_cast<QelModelObject*>(impl->FindOwnInterface(ClassIID)) : nullptr;
  }

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  HRESULT GetAlias(QelUnicodeString& alias) override;
  HRESULT GetIconName(QelUnicodeString& name) override;

  const std::string& Alias() const { return alias_; }
  const std::string& Icon() const { return icon_; }
  bool IsShown() const { return shown_; }
  void SetShown(bool shown) { shown_ = shown; }
  // Whether the object stays shown when enabled with this filter data; only annotations
  // are refined by it (a virtual call, so a display pass needs no second cast).
  virtual bool PassesFilter(const QelRovFacetFilterData& /*filter*/) const { return true; }

 protected:
  QelModelObject(std::string alias, std::string icon, bool shown);
  ~QelModelObject() override;
  void* QueryDirect(const QelIID& iid) override;

 private:
  std::string alias_;
  std::string icon_;
  bool shown_;
};
