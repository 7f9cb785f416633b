#include "QelBaseUnknown_WR.h"

#include <utility>

QelBaseUnknown_WR::QelBaseUnknown_WR(QelBaseUnknown* object) {
  if (!object) return;
  object_ = object->GetImpl();
  flag_ = object_->AcquireWeakFlag();
  ++flag_->refs;
}

QelBaseUnknown_WR::QelBaseUnknown_WR(const QelBaseUnknown_WR& other) : flag_(other.flag_), object_(other.object_) {
  if (flag_) ++flag_->refs;
}

QelBaseUnknown_WR& QelBaseUnknown_WR::operator=(const QelBaseUnknown_WR& other) {
  if (other.flag_) ++other.flag_->refs;
  Reset();
  flag_ = other.flag_;
  object_ = other.object_;
  return *this;
}

QelBaseUnknown_WR::~QelBaseUnknown_WR() { Reset(); }

void QelBaseUnknown_WR::Reset() {
  if (QelWeakFlag* flag = std::exchange(flag_, nullptr))
    if (--flag->refs == 0) delete flag;
  object_ = nullptr;
}

QelBaseUnknown* QelBaseUnknown_WR::GetRaw() const { return flag_ && flag_->alive ? object_ : nullptr; }

QelBaseUnknown_var QelBaseUnknown_WR::Get() const { return QelBaseUnknown_var::Retain(GetRaw()); }
