#pragma once
// QelListValQelBaseUnknown_var: the component model's list of counted handles. Positions
// are 1-based; the list holds one reference per entry. Comparisons use IsEqual, so a tie
// and the object behind it are the same entry.
#include <vector>

#include "QelVar.h"

class QelListValQelBaseUnknown_var {
 public:
  int Size() const { return static_cast<int>(items_.size()); }
  void Append(QelBaseUnknown* object) { items_.emplace_back(QelBaseUnknown_var(object)); }
  void Append(const QelBaseUnknown_var& object) { items_.push_back(object); }
  void Append(const QelListValQelBaseUnknown_var& other);
  // Position 1..Size(); anything else is a broken contract and gives a null handle. Read
  // only: an out-of-range position must not hand out something a caller could write to.
  const QelBaseUnknown_var& operator[](int position) const;
  // 1-based position of the first entry equal to `object`, 0 when absent.
  int Locate(QelBaseUnknown* object) const;
  // Removes the first entry equal to `object`; its former position, or 0.
  int RemoveValue(QelBaseUnknown* object);
  void RemovePosition(int position);
  // Keeps the first of equal entries, in order.
  void RemoveDuplicates();
  void RemoveAll() { items_.clear(); }
  // Room for `count` entries in all, so a long listing grows its storage once.
  void Reserve(int count) { if (count > 0) items_.reserve(static_cast<size_t>(count)); }

  auto begin() const { return items_.begin(); }
  auto end() const { return items_.end(); }

 private:
  std::vector<QelBaseUnknown_var> items_;
};
