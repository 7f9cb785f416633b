#pragma once
// QelSYPWRefMethEventHandler<T>: an event handler that calls a member of a receiver it
// holds weakly, so a widget's handler never keeps the receiver alive. When the receiver
// is gone the event does nothing; while the member runs the handler holds a reference on
// the receiver, so the receiver may drop its last other reference inside the call.
//
//   QelSYPWRefMethEventHandler<QelRovRefinementFacet>::Connect(
//       propertyWidget, QelRovRefinementProperty::SendPropEvent(), this,
//       &QelRovRefinementFacet::ForwardPropertyEvent);
#include "QelBaseUnknown_WR.h"
#include "QelSYPEventArgs.h"
#include "QelSYPEventHandler.h"
#include "QelToolkitCheck.h"
#include "QelVidWidget.h"

template <class T>
class QelSYPWRefMethEventHandler final : public QelSYPEventHandler {
 public:
  using Member = void (T::*)(QelBaseUnknown* origin, QelSYPEventArgs* args);

  QelSYPWRefMethEventHandler(T* i_pObj, Member i_pMemberFunc) : memberFunc_(i_pMemberFunc) {
    if (!i_pObj) return;
    // A weak reference resolves to the implementation: an extension would be lost.
    if (!QelTkCheckCondition(i_pObj->GetImpl() == static_cast<QelBaseUnknown*>(i_pObj),
                             "i_pObj->GetImpl() == i_pObj",
                             "i_pObj may be an extension; referencing an extension with a weak-ref is not possible."))
      return;
    receiver_ = QelBaseUnknown_WR(static_cast<QelBaseUnknown*>(i_pObj));
    QelTkCheckCondition(memberFunc_ != nullptr, "_pMemberFunc != NULL");
  }

  // Connects a new handler on `i_pSupport` for `i_pEvent`. 0 (nothing connected) after a
  // failed check; otherwise what AddHandler answers.
  static int Connect(QelVidWidget* i_pSupport, QelSYPEvent* i_pEvent, T* i_pObj, Member i_pMemberFunc) {
    if (!QelTkCheckPointer(i_pSupport, "i_pSupport")) return 0;
    if (!QelTkCheckPointer(i_pEvent, "i_pEvent")) return 0;
    if (!QelTkCheckPointer(i_pObj, "i_pObj")) return 0;
    if (!QelTkCheckCondition(i_pMemberFunc != nullptr, "i_pMemberFunc != NULL")) return 0;
    QelVar<QelSYPWRefMethEventHandler> handler = QelMakeVar<QelSYPWRefMethEventHandler>(i_pObj, i_pMemberFunc);
    return i_pSupport->AddHandler(i_pEvent, handler.get(), 0);
  }

  void HandleEvent(QelVidWidget*, QelBaseUnknown* args) override {
    auto* pArgs = dynamic_cast<QelSYPEventArgs*>(args);
    if (!QelTkCheckPointer(pArgs, "pArgs")) return;
    if (!memberFunc_) return;
    QelBaseUnknown_var held = receiver_.Get();
    T* receiver = held ? dynamic_cast<T*>(held.get()) : nullptr;
    if (!receiver) return;
    (receiver->*memberFunc_)(pArgs->GetOrigin(), pArgs);
  }

  bool RefersTo(QelBaseUnknown* object) const { return receiver_.RefersTo(object); }

 protected:
  ~QelSYPWRefMethEventHandler() override = default;

 private:
  QelBaseUnknown_WR receiver_;
  Member memberFunc_;
};
