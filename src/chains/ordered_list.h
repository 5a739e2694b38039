// An ordered, growable sequence: appended at the end, erased in place keeping
// the order of the rest. Nothing here checks an index; callers check their own.
#pragma once

#include <cstdint>
#include <vector>

template <typename T>
class OrderedList {
 public:
  uint32_t Count() const { return static_cast<uint32_t>(items_.size()); }

  // True when `index`, taken as signed, names an element.
  bool Holds(int32_t index) const { return index >= 0 && static_cast<uint32_t>(index) < Count(); }

  T& At(uint32_t index) { return items_[index]; }
  const T& At(uint32_t index) const { return items_[index]; }

  // Adds the element at the end. False when memory ran out; the list is then
  // exactly as it was.
  bool Append(const T& item) noexcept {
    try {
      items_.push_back(item);
      return true;
    } catch (...) {
      return false;
    }
  }

  // Removes one element; later elements move down one index. Storage is kept.
  void RemoveAt(uint32_t index) { items_.erase(items_.begin() + index); }

  // Frees the storage and leaves the list empty.
  void Release() { std::vector<T>().swap(items_); }

 private:
  std::vector<T> items_;
};
