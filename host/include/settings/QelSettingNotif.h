#pragma once
// QelSettingNotif: the payload of a repository's "Repository_Modified" notification, naming
// the setting that was written. It is made for one dispatch; a subscriber that wants the
// name later copies it rather than keeping the notification.
#include "QelBaseUnknown.h"
#include "QelString.h"

class QelSettingNotif : public QelBaseUnknown {
 public:
  explicit QelSettingNotif(const QelString& name) : name_(name) {}

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

  const QelString& GetName() const { return name_; }

 protected:
  ~QelSettingNotif() override = default;

 private:
  QelString name_;
};
