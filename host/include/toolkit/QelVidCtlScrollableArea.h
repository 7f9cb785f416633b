#pragma once
// QelVidCtlScrollableArea: a container whose content may be scrolled; it keeps the
// horizontal and vertical offsets, never negative.
#include "QelVidCtl.h"

class QelVidCtlScrollableArea : public QelVidCtl {
 public:
  QelVidCtlScrollableArea(QelVidWidget* parent, const QelString& name) : QelVidCtl(parent, name) {}
  const char* GetWidgetKind() const override { return "ScrollableArea"; }

  int GetHScrollOffset() const { return h_; }
  int GetVScrollOffset() const { return v_; }
  void SetHScrollOffset(int offset) { h_ = offset < 0 ? 0 : offset; }
  void SetVScrollOffset(int offset) { v_ = offset < 0 ? 0 : offset; }

 protected:
  ~QelVidCtlScrollableArea() override = default;

 private:
  int h_ = 0;
  int v_ = 0;
};
