#pragma once
// QelFrm3DCamera: the frame's named 3D camera, a counted value. A new one looks from
// (0, 0, 1) at the origin along -z with +y up.
#include "QelI3DCamera.h"

class QelFrm3DCamera : public QelI3DCamera {
 public:
  explicit QelFrm3DCamera(const char* name);

  HRESULT GetOrigin(QelMathPoint& origin) override;
  HRESULT GetTarget(QelMathPoint& target) override;
  HRESULT GetDirection(QelMathVector& sight) override;
  HRESULT GetZenith(QelMathVector& up) override;
  HRESULT SetOrigin(const QelMathPoint& origin) override;
  HRESULT SetTarget(const QelMathPoint& target) override;
  HRESULT SetDirection(const QelMathVector& sight) override;
  HRESULT SetZenith(const QelMathVector& up) override;
  HRESULT CopyFrom(QelICamera* source) override;
  QelString GetName() override { return name_; }

 protected:
  ~QelFrm3DCamera() override = default;
  void* QueryDirect(const QelIID& iid) override;

 private:
  QelString name_;
  QelMathPoint origin_{0.0, 0.0, 1.0};
  QelMathPoint target_{};
  QelMathVector direction_{0.0, 0.0, -1.0};
  QelMathVector zenith_{0.0, 1.0, 0.0};
};
