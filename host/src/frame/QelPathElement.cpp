#include "QelPathElement.h"

#include "QelAssert.h"
#include "QelMetaObject.h"

const QelMetaObject& QelPathElement::MetaObject() {
  static const QelMetaObject& meta =
      QelMetaObject::Declare("QelPathElement", QelMetaKind::Implementation, &QelBaseUnknown::MetaObject(), "QelHost");
  return meta;
}

void QelPathElement::AddChildElement(QelBaseUnknown* object) {
  if (!object) {
    QelAssertPointer("path element");
    return;
  }
  elements_.emplace_back(object);
}

QelBaseUnknown_var QelPathElement::operator[](int index) const {
  if (index < 0 || index >= GetSize()) return nullptr;
  return elements_[static_cast<size_t>(index)];
}

QelBaseUnknown_var QelPathElement::GetLeaf() const { return elements_.empty() ? nullptr : elements_.back(); }

QelBaseUnknown_var QelPathElement::NextFatherElement() {
  if (cursor_ < 0 || cursor_ >= GetSize()) return nullptr;
  return elements_[static_cast<size_t>(cursor_--)];
}

QelBaseUnknown_var QelPathElement::NextChildElement() {
  if (cursor_ < 0 || cursor_ >= GetSize()) return nullptr;
  return elements_[static_cast<size_t>(cursor_++)];
}

QelVar<QelPathElement> QelPathElement::Copy() const {
  auto copy = QelMakeVar<QelPathElement>();
  copy->elements_ = elements_;
  copy->cursor_ = cursor_;
  return copy;
}

bool QelPathElement::IsSamePath(const QelPathElement* other) const {
  if (!other || other->GetSize() != GetSize()) return false;
  for (size_t i = 0; i < elements_.size(); ++i)
    if (!elements_[i]->IsEqual(other->elements_[i].get())) return false;
  return true;
}
