#pragma once
// QelBaseUnknown: the root of every object the host and the module exchange.
//
// Objects are reference counted and start with one reference, owned by their creator,
// who adopts it into a handle (QelMakeVar, QelVar::Adopt) or gives it back (Release).
// They are destroyed by the Release that drops the count to zero, never by `delete`
// (destructors are non-public; QelVar refuses a counted type whose destructor is public).
// Debug builds report a reference added to an object whose first reference has no owner
// yet (`QelVar<T> v(new T)` leaks), a count left unbalanced by a destructor, and an
// object made, retained or released off the thread that made the first object (counts
// are not atomic). Interfaces derive *virtually* from QelBaseUnknown, so an
// object that implements several interfaces directly still has one count. An interface
// may also be provided by a tie (a small counted object forwarding to the
// implementation) or by a data extension; both are found through QelDictionary.
//
//   QelVar<QelIAlias> alias = object;   // queries; null when the object has no alias
//   if (alias) name = alias->GetAlias();
#include <cstddef>
#include <cstdint>

#include "QelIID.h"
#include "QelStatus.h"

class QelMetaObject;
struct QelWeakFlag;

class QelBaseUnknown {
 public:
  // Marks the class as an interface for QelVar: each interface redeclares both.
  using QelInterfaceSelf = QelBaseUnknown;
  static constexpr QelIID IID = QelIID::Parse("{5E0C41A2-7B61-4C39-9D0A-0B3F5A1E2C01}");

  QelBaseUnknown(const QelBaseUnknown&) = delete;
  QelBaseUnknown& operator=(const QelBaseUnknown&) = delete;

  uint32_t AddRef();
  uint32_t Release();
  // Records that the first reference has an owner; QelVar::Adopt and the component model
  // call it where they hand a new reference on.
  void NoteAdopted() { firstReferenceOwned_ = true; }

  // Gives, with a new reference, the pointer for `iid`: the object itself, a tie, or an
  // interface of a data extension of the object's late type. E_NOINTERFACE and a null
  // `out` when the object has none.
  virtual HRESULT QueryInterface(const QelIID& iid, void** out);

  // What QueryInterface would answer for an interface the object's own class implements,
  // but borrowed (no reference) and without the dictionary: for hot paths over objects the
  // caller already holds. Null when the class itself does not answer `iid`.
  void* FindOwnInterface(const QelIID& iid) { return QueryDirect(iid); }

  // The object that really implements: a tie answers its implementation, others themselves.
  virtual QelBaseUnknown* GetImpl();

  // The class description; implementation classes override it with their own.
  virtual const QelMetaObject* GetMetaObject() const;
  static const QelMetaObject& MetaObject();

  // The type under which data extensions are looked up; by default the class name.
  virtual const char* GetLateType() const;

  const char* IsA() const;
  bool IsAKindOf(const char* className) const;
  // Identity of the implementation, so a tie equals the object it forwards to.
  bool IsEqual(QelBaseUnknown* other);

  // Number of QelBaseUnknown objects alive in the process: a debug aid that lets tests
  // prove a scenario leaks nothing and leaves no cycle behind.
  static int64_t LiveObjectCount();

  // True from the Release that drops the count to zero until the memory goes: lets an
  // owner's raw back-links stop resolving before any destructor runs, as weak ones do.
  bool IsBeingDestroyed() const { return refs_ >= kDestroying; }
  // True when the caller's reference is the only one: releasing it would destroy the object.
  // Lets an owner of a deep tree take a child's children before letting the child go.
  bool HasOneReference() const { return refs_ == 1; }

 protected:
  QelBaseUnknown();
  virtual ~QelBaseUnknown();

  // The interfaces the class implements itself; overrides answer theirs, then defer to
  // their base class. See QelQueryDirect in QelVar.h for the usual form.
  virtual void* QueryDirect(const QelIID& iid);

 private:
  friend class QelBaseUnknown_WR;
  QelWeakFlag* AcquireWeakFlag();
  QelBaseUnknown* FindOrCreateExtension(const QelMetaObject& extension);

  struct Extensions;
  // A count this high marks an object in destruction: a balanced AddRef/Release made by
  // code the destructor calls cannot reach zero again and delete twice.
  static constexpr uint32_t kDestroying = 1u << 30;
  uint32_t refs_ = 1;
  bool firstReferenceOwned_ = false;
  QelWeakFlag* weak_ = nullptr;
  Extensions* extensions_ = nullptr;
};
