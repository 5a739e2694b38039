// An ordered, growable sequence: appended at the end, erased in place keeping
// the order of the rest. Nothing here checks an index; callers check their own.
#pragma once

#include <algorithm>
#include <cstdint>

#include "chains/growable_array.h"

template <typename T>
class OrderedList {
 public:
  uint32_t Count() const { return items_.Count(); }

  // True when `index`, taken as signed, names an element.
  bool Holds(int32_t index) const { return index >= 0 && static_cast<uint32_t>(index) < Count(); }

  T& At(uint32_t index) { return items_[index]; }
  const T& At(uint32_t index) const { return items_[index]; }

  // Adds the element at the end. False when memory ran out; the list is then
  // exactly as it was.
  bool Append(const T& item) noexcept { return items_.Append(item); }

  // Removes one element; later elements move down one index. Storage is kept.
  void RemoveAt(uint32_t index) {
    items_.Erase(index, 1);
    ++removals_;
  }

  // Removes every element for which `doomed` is true, keeping the order of
  // the rest, in one walk. Storage is kept.
  template <typename Predicate>
  void RemoveIf(Predicate doomed) {
    const T* end = std::remove_if(items_.begin(), items_.end(), doomed);
    if (end == items_.end()) return;
    items_.Erase(static_cast<uint32_t>(end - items_.begin()), static_cast<uint32_t>(items_.end() - end));
    ++removals_;
  }

  // How many times elements have left the list. While it stays the same,
  // every element keeps its position, so an index of positions stays valid.
  uint64_t Removals() const { return removals_; }

 private:
  GrowableArray<T> items_;
  uint64_t removals_ = 0;
};
