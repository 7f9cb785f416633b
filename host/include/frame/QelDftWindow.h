#pragma once
// QelDftWindow: a drafting window of a layout. Its kind is its class, so code asks
// IsAKindOf("QelDftWindow") rather than testing a flag; lifetime as QelFrmWindow.
#include "QelFrmWindow.h"

class QelDftWindow : public QelFrmWindow {
 public:
  explicit QelDftWindow(QelFrmEditor* editor) : QelFrmWindow(editor) {}

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

 protected:
  ~QelDftWindow() override = default;
};
