#pragma once
// Qel3DWindow: a 3D window of a layout. Its kind is its class, so code asks
// IsAKindOf("Qel3DWindow") rather than testing a flag; lifetime as QelFrmWindow.
#include "QelFrmWindow.h"

class Qel3DWindow : public QelFrmWindow {
 public:
  explicit Qel3DWindow(QelFrmEditor* editor) : QelFrmWindow(editor) {}

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

 protected:
  ~Qel3DWindow() override = default;
};
