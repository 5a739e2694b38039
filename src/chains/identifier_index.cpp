#include "chains/identifier_index.h"

// Fibonacci hashing: the top bits of the identifier times 2^64 / phi. Spreads
// the consecutive identifiers that hosts hand out over the whole table.
std::size_t IdentifierIndex::Home(int32_t id) const {
  const uint64_t product = static_cast<uint64_t>(static_cast<uint32_t>(id)) * 0x9E3779B97F4A7C15ull;
  return static_cast<std::size_t>(product >> shift_);
}

bool IdentifierIndex::Insert(int32_t id, uint32_t position) noexcept {
  if ((used_ + 1) * 2 > slots_.Count() && !Grow()) return false;
  const std::size_t mask = slots_.Count() - 1;
  for (std::size_t s = Home(id);; s = (s + 1) & mask) {
    if (slots_[s].position == kEmpty) {
      slots_[s] = {id, position};
      ++used_;
      return true;
    }
    if (slots_[s].id == id) return true;  // the earlier position stays
  }
}

bool IdentifierIndex::Grow() noexcept {
  GrowableArray<Slot> grown;
  if (!grown.GrowTo(slots_.Count() == 0 ? 16 : 2 * std::size_t{slots_.Count()}, Slot{0, kEmpty})) return false;
  grown.Swap(slots_);
  shift_ = 64;
  for (std::size_t size = slots_.Count(); size > 1; size >>= 1) --shift_;
  used_ = 0;
  for (const Slot& slot : grown) {
    if (slot.position != kEmpty) Insert(slot.id, slot.position);  // room enough: cannot fail
  }
  return true;
}

std::optional<uint32_t> IdentifierIndex::Lookup(int32_t id) const {
  if (slots_.Count() == 0) return std::nullopt;
  const std::size_t mask = slots_.Count() - 1;
  for (std::size_t s = Home(id); slots_[s].position != kEmpty; s = (s + 1) & mask) {
    if (slots_[s].id == id) return slots_[s].position;
  }
  return std::nullopt;
}

void IdentifierIndex::Clear() noexcept {
  for (Slot& slot : slots_) slot.position = kEmpty;
  used_ = 0;
  indexed_ = 0;
}
