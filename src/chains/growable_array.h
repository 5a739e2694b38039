// A growable array of plain values, over realloc and free. Growing reports
// failure instead of throwing, and a call that fails leaves the array exactly
// as it was. Elements are moved as bytes, so they must be trivially copyable.
#pragma once

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <type_traits>
#include <utility>

template <typename T>
class GrowableArray {
  static_assert(std::is_trivially_copyable_v<T>);

 public:
  GrowableArray() = default;
  GrowableArray(const GrowableArray&) = delete;
  GrowableArray& operator=(const GrowableArray&) = delete;
  ~GrowableArray() { std::free(items_); }

  uint32_t Count() const { return count_; }
  T& operator[](uint32_t index) { return items_[index]; }
  const T& operator[](uint32_t index) const { return items_[index]; }
  T* begin() { return items_; }
  T* end() { return items_ + count_; }
  const T* begin() const { return items_; }
  const T* end() const { return items_ + count_; }

  // Adds `item` at the end; the storage doubles when full. False when memory
  // ran out.
  bool Append(const T& item) noexcept {
    const T copy = item;  // `item` may live in the storage that moves
    if (count_ == capacity_ && !Reserve(capacity_ == 0 ? 8 : 2 * static_cast<std::size_t>(capacity_))) return false;
    items_[count_++] = copy;
    return true;
  }

  // Grows the array to `count` elements, the new ones copies of `fill`. False
  // when memory ran out.
  bool GrowTo(std::size_t count, const T& fill) noexcept {
    if (count > capacity_ && !Reserve(count)) return false;
    for (; count_ < count; ++count_) items_[count_] = fill;
    return true;
  }

  // Removes `removed` elements from `first` on; later ones move down, in
  // order. The storage is kept.
  void Erase(uint32_t first, uint32_t removed) {
    std::memmove(items_ + first, items_ + first + removed, (count_ - first - removed) * sizeof(T));
    count_ -= removed;
  }

  void Swap(GrowableArray& other) {
    std::swap(items_, other.items_);
    std::swap(count_, other.count_);
    std::swap(capacity_, other.capacity_);
  }

 private:
  bool Reserve(std::size_t capacity) noexcept {
    // The count stays a 32-bit number, and the byte size must not wrap.
    if (capacity > UINT32_MAX || capacity > SIZE_MAX / sizeof(T)) return false;
    void* grown = std::realloc(items_, capacity * sizeof(T));
    if (grown == nullptr) return false;
    items_ = static_cast<T*>(grown);
    capacity_ = static_cast<uint32_t>(capacity);
    return true;
  }

  T* items_ = nullptr;
  uint32_t count_ = 0;
  uint32_t capacity_ = 0;
};
