#pragma once
// QelCSO: an editor's current selection of objects. It publishes
// kQelCSOChangeNotification (no payload) each time its content really changes. The
// editor owns it; it holds counted handles on the selected objects.
#include "QelListValQelBaseUnknown_var.h"

inline constexpr const char* kQelCSOChangeNotification = "QelCSOChangeNotification";

class QelCSO : public QelBaseUnknown {
 public:
  QelCSO() = default;

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

  const QelListValQelBaseUnknown_var& GetElements() const { return elements_; }
  int GetSize() const { return elements_.Size(); }

  // Replaces the selection; null entries are dropped. True when it changed.
  bool SetSelection(const QelListValQelBaseUnknown_var& objects);
  // One object, or an empty selection for null.
  bool SetSelection(QelBaseUnknown* object);
  bool Empty();

 protected:
  ~QelCSO() override = default;

 private:
  QelListValQelBaseUnknown_var elements_;
};
