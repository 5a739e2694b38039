// The first position of each object identifier in one list, so that finding
// an object by its identifier costs the same at any list length.
//
// The index covers a prefix of the list. The elements appended since the last
// lookup join it at the next one, in list order, and an identifier keeps the
// first position it was given, so the answer is the first match that a walk
// from position 0 would find, also for an identifier held several times. A
// removal moves every later element down, so after one the index starts
// again from position 0; removals happen at most a few times per frame, in
// the swing step. Identifiers are read from the host objects, which keep
// theirs for their whole life.
#pragma once

#include <cstdint>
#include <optional>

#include "chains/growable_array.h"

class IdentifierIndex {
 public:
  // The first of a list's `count` elements whose identifier is `id`, or none.
  // `removals` is the list's removal count, `idAt(i)` the identifier of
  // element i. Without memory for the index, the list is walked instead.
  template <typename IdAt>
  std::optional<uint32_t> Find(int32_t id, uint32_t count, uint64_t removals, IdAt idAt) {
    if (removals != removals_) {
      Clear();
      removals_ = removals;
    }
    for (; indexed_ < count; ++indexed_) {
      if (!Insert(idAt(indexed_), indexed_)) {
        Clear();
        for (uint32_t i = 0; i < count; ++i) {
          if (idAt(i) == id) return i;
        }
        return std::nullopt;
      }
    }
    return Lookup(id);
  }

 private:
  static constexpr uint32_t kEmpty = UINT32_MAX;
  struct Slot {
    int32_t id;
    uint32_t position;  // kEmpty: no identifier here
  };

  // False when memory ran out.
  bool Insert(int32_t id, uint32_t position) noexcept;
  bool Grow() noexcept;
  std::optional<uint32_t> Lookup(int32_t id) const;
  void Clear() noexcept;  // keeps the storage
  std::size_t Home(int32_t id) const;

  GrowableArray<Slot> slots_;  // open addressing, linear probing, at most half full
  int shift_ = 64;           // 64 - log2 of the slot count
  std::size_t used_ = 0;
  uint32_t indexed_ = 0;  // elements 0 to indexed_ - 1 are in the index
  uint64_t removals_ = 0;
};
