#pragma once
// QelBoxingOfQelVidColor: carries a colour through an introspection getter that hands out
// counted objects. Box gives a new object with one reference, owned by the caller.
#include "QelBaseUnknown.h"
#include "QelVidColor.h"

class QelBoxedQelVidColor : public QelBaseUnknown {
 public:
  explicit QelBoxedQelVidColor(const QelVidColor& color) : color_(color) {}
  const QelVidColor& Color() const { return color_; }

 protected:
  ~QelBoxedQelVidColor() override = default;

 private:
  QelVidColor color_;
};

class QelBoxingOfQelVidColor {
 public:
  static QelBaseUnknown* Box(const QelVidColor& color);
  // The colour in a boxed object; false when `boxed` is none.
  static bool Unbox(QelBaseUnknown* boxed, QelVidColor& color);

  QelBoxingOfQelVidColor() = delete;
};
