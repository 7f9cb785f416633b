#include "QelBaseUnknown.h"

#include <cstdio>
#include <thread>
#include <utility>
#include <vector>

#include "QelAssert.h"
#include "QelBaseUnknown_WR.h"
#include "QelDictionary.h"
#include "QelMetaObject.h"

namespace {
int64_t g_liveObjects = 0;
// Counts, weak flags and observer lists assume one thread: the one that made the first
// counted object. Debug builds turn that assumption into a check, so work handed to
// another thread (a renderer, a server) that touches a counted object is reported
// instead of racing on its count.
#ifndef NDEBUG
std::thread::id g_owningThread;
void CheckOwningThread() {
  const std::thread::id here = std::this_thread::get_id();
  if (g_owningThread == std::thread::id()) g_owningThread = here;
  else if (here != g_owningThread) QelAssertBool("counted object used off its owning thread");
}
#else
void CheckOwningThread() {}
#endif
}  // namespace

struct QelBaseUnknown::Extensions {
  std::vector<std::pair<const QelMetaObject*, QelBaseUnknown*>> items;
};

QelBaseUnknown::QelBaseUnknown() {
  CheckOwningThread();
  ++g_liveObjects;
}

QelBaseUnknown::~QelBaseUnknown() {
  if (extensions_) {
    // Taken out first: an extension's destructor may query this object again.
    Extensions* owned = std::exchange(extensions_, nullptr);
    for (auto& [meta, extension] : owned->items) extension->Release();
    delete owned;
  }
  if (weak_) {
    weak_->alive = false;
    if (--weak_->refs == 0) delete weak_;
  }
  --g_liveObjects;
  // Every derived destructor has run: what they added and released must balance. Less
  // means a Release too many (a handle somewhere will release freed memory); more means
  // somebody kept a reference to an object that is gone.
  if (refs_ < kDestroying) QelAssertBool("release past zero");
  else if (refs_ > kDestroying) QelAssertBool("reference kept on a destroyed object");
}

int64_t QelBaseUnknown::LiveObjectCount() { return g_liveObjects; }

uint32_t QelBaseUnknown::AddRef() {
  CheckOwningThread();
  // A second reference while the first has no owner: `QelVar<T> v(new T)` and the like,
  // whose creation reference is never released.
  if (refs_ == 1 && !firstReferenceOwned_) {
    firstReferenceOwned_ = true;  // reported once
    QelAssertBool("first reference not adopted");
  }
  return ++refs_;
}

uint32_t QelBaseUnknown::Release() {
  CheckOwningThread();
  firstReferenceOwned_ = true;  // the creator gave its reference back
  if (--refs_ != 0) return refs_;
  refs_ = kDestroying;
  // Weak references die before the destructors run, so no upward link can reach a
  // half-destroyed object.
  if (weak_) weak_->alive = false;
  delete this;
  return 0;
}

QelWeakFlag* QelBaseUnknown::AcquireWeakFlag() {
  if (!weak_) weak_ = new QelWeakFlag{1, refs_ < kDestroying};
  return weak_;
}

const QelMetaObject& QelBaseUnknown::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelBaseUnknown", QelMetaKind::Implementation, nullptr, "QelHost");
  return meta;
}

const QelMetaObject* QelBaseUnknown::GetMetaObject() const { return &MetaObject(); }

const char* QelBaseUnknown::GetLateType() const { return GetMetaObject()->Name(); }

const char* QelBaseUnknown::IsA() const { return GetMetaObject()->Name(); }

bool QelBaseUnknown::IsAKindOf(const char* className) const {
  return className && GetMetaObject()->IsAKindOf(className);
}

bool QelBaseUnknown::IsEqual(QelBaseUnknown* other) {
  return other && GetImpl() == other->GetImpl();
}

QelBaseUnknown* QelBaseUnknown::GetImpl() { return this; }

void* QelBaseUnknown::QueryDirect(const QelIID& iid) {
  return iid == QelBaseUnknown::IID ? this : nullptr;
}

QelBaseUnknown* QelBaseUnknown::FindOrCreateExtension(const QelMetaObject& extension) {
  // An object in destruction has already released its extensions; one made now would
  // never be released.
  if (refs_ >= kDestroying) return nullptr;
  if (!extensions_) extensions_ = new Extensions;
  for (auto& [meta, object] : extensions_->items)
    if (meta == &extension) return object;
  for (const auto* entry : QelDictionary::Get().ExtensionsOf(GetLateType())) {
    if (entry->extension != &extension) continue;
    QelBaseUnknown* created = entry->creator(this);
    if (created) {
      created->NoteAdopted();  // the extended object owns it
      extensions_->items.emplace_back(&extension, created);
    }
    return created;
  }
  return nullptr;
}

HRESULT QelBaseUnknown::QueryInterface(const QelIID& iid, void** out) {
  if (!out) return E_UNEXPECTED;
  *out = nullptr;
  if (void* mine = QueryDirect(iid)) {
    AddRef();
    *out = mine;
    return S_OK;
  }
  const QelDictionary& dictionary = QelDictionary::Get();
  if (!dictionary.HasFactoryFor(iid)) return E_NOINTERFACE;
  // Answer with the factory (tie or direct) from the dictionary: first the ties of the
  // object's class and its ancestors, then the data extensions of its late type.
  auto answerWith = [&](QelFactory factory, QelBaseUnknown* impl) -> HRESULT {
    QelBaseUnknown* made = factory(impl);
    if (!made) return E_NOINTERFACE;
    made->NoteAdopted();  // the reference is the caller's
    void* found = made->QueryDirect(iid);
    if (!found) {
      made->Release();
      return E_NOINTERFACE;
    }
    *out = found;  // the factory's reference becomes the caller's
    return S_OK;
  };
  for (const QelMetaObject* meta = GetMetaObject(); meta; meta = meta->Base())
    if (QelFactory factory = dictionary.FindFactory(meta->Name(), iid)) return answerWith(factory, this);
  if (QelFactory factory = dictionary.FindFactory(GetLateType(), iid)) return answerWith(factory, this);
  for (const auto* entry : dictionary.ExtensionsOf(GetLateType())) {
    for (const QelMetaObject* meta = entry->extension; meta; meta = meta->Base()) {
      QelFactory factory = dictionary.FindFactory(meta->Name(), iid);
      if (!factory) continue;
      QelBaseUnknown* extension = FindOrCreateExtension(*entry->extension);
      return extension ? answerWith(factory, extension) : E_NOINTERFACE;
    }
  }
  return E_NOINTERFACE;
}
