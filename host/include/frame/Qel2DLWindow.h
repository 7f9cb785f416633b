#pragma once
// Qel2DLWindow: a 2D layout window of a layout. Its kind is its class, so code asks
// IsAKindOf("Qel2DLWindow") rather than testing a flag; lifetime as QelFrmWindow.
#include "QelFrmWindow.h"

class Qel2DLWindow : public QelFrmWindow {
 public:
  explicit Qel2DLWindow(QelFrmEditor* editor) : QelFrmWindow(editor) {}

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

 protected:
  ~Qel2DLWindow() override = default;
};
