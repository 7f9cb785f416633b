#pragma once
// QelPathElement: a path of objects from a root (position 0) down to a leaf, with a
// cursor for walking it towards the root. The path holds a counted handle on each element;
// the elements never point back at a path. Copy before moving the cursor of a path that
// someone else walks.
//
//   path->InitToLeafElement();
//   QelBaseUnknown_var leaf = path->NextFatherElement();     // the leaf itself
//   QelBaseUnknown_var parent = path->NextFatherElement();   // one step up; null past the root
#include <vector>

#include "QelVar.h"

class QelPathElement : public QelBaseUnknown {
 public:
  QelPathElement() = default;

  static const QelMetaObject& MetaObject();
  const QelMetaObject* GetMetaObject() const override { return &MetaObject(); }

  // Appends below the current leaf; a null object is a broken contract and is not added.
  void AddChildElement(QelBaseUnknown* object);
  int GetSize() const { return static_cast<int>(elements_.size()); }
  // 0-based from the root; null outside 0..GetSize()-1.
  QelBaseUnknown_var operator[](int index) const;
  QelBaseUnknown_var GetLeaf() const;

  // The cursor: NextFatherElement answers the element under it and moves it one step up.
  void InitToLeafElement() { cursor_ = GetSize() - 1; }
  void InitToRootElement() { cursor_ = 0; }
  QelBaseUnknown_var NextFatherElement();
  QelBaseUnknown_var NextChildElement();

  // A new path with the same elements (the objects are shared) and cursor.
  QelVar<QelPathElement> Copy() const;
  // Same length and, position by position, the same implementation objects.
  bool IsSamePath(const QelPathElement* other) const;

 protected:
  ~QelPathElement() override = default;

 private:
  std::vector<QelBaseUnknown_var> elements_;
  int cursor_ = -1;  // -1 or GetSize(): walked off the path
};
