#pragma once
// QelLumCapture: a capture of a set: an optional stored camera (owned) and an optional
// link to a view of the same set (weak). Captures of light sets have the late type
// "QelTPSLightCapture".
#include "QelBaseUnknown_WR.h"
#include "QelILumCapture.h"
#include "QelISetMember.h"
#include "QelITPSLight.h"
#include "QelModelObject.h"

class QelLumAnnotationSet;

class QelLumCapture : public QelModelObject, public QelILumCapture, public QelISetMember, public QelITPSLight {
 public:
  QelLumCapture(QelLumAnnotationSet* set, std::string alias, std::string icon, QelBaseUnknown* view,
                QelICamera* camera, bool shown);

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override;
  const char* GetLateType() const override;

  HRESULT GetSet(QelBaseUnknown_var& set) override;
  // Leaves the object listed under its set without a link back to it.
  void DetachSet() { set_.Reset(); }
  HRESULT IsLinkedToView(bool& linked) override;
  HRESULT GetLinkedView(QelBaseUnknown_var& view) override;
  HRESULT GetCamera(QelVar<QelICamera>& camera) override;
  HRESULT GetOwner(QelBaseUnknown_var& set) override;

  QelLumAnnotationSet* Set() const;
  QelBaseUnknown* LinkedView() const { return view_.GetRaw(); }
  QelICamera* Camera() const { return camera_.get(); }

 protected:
  ~QelLumCapture() override;
  void* QueryDirect(const QelIID& iid) override;

 private:
  QelBaseUnknown_WR set_;
  QelBaseUnknown_WR view_;
  QelVar<QelICamera> camera_;
  bool light_;
};
