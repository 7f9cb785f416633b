#pragma once
// QelLumCamera: the stored camera of a capture, a counted value owned by its capture.
#include "QelICamera.h"

class QelLumCamera : public QelICamera {
 public:
  QelLumCamera(const QelMathPoint& origin, const QelMathPoint& target, const QelMathVector& zenith);

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;

  HRESULT GetOrigin(QelMathPoint& origin) override;
  HRESULT GetTarget(QelMathPoint& target) override;
  HRESULT GetDirection(QelMathVector& sight) override;
  HRESULT GetZenith(QelMathVector& up) override;

 protected:
  ~QelLumCamera() override;
  void* QueryDirect(const QelIID& iid) override;

 private:
  QelMathPoint origin_;
  QelMathPoint target_;
  QelMathVector zenith_;
};
