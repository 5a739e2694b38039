#include "events/event_tables.h"

#include <bit>
#include <iterator>

#include "frame/run_info.h"
#include "resources/resource_ids.h"

static_assert(std::endian::native == std::endian::little,
              "the host reads the tables as little-endian words in memory");

namespace {

// Parameter types of condition and action entries.
constexpr uint16_t kObject = 1;       // an object of the frame: the routine gets its HostObject
constexpr uint16_t kExpression = 22;  // a number: the routine gets its value
// Parameter types of expression entries. The delta expressions carry 2 where
// the others carry 1; their routines read it as an integer all the same.
constexpr uint16_t kInteger = 1;
constexpr uint16_t kDeltaInteger = 2;

constexpr uint16_t kSwingingConditionFlags = 0x0220;
constexpr uint16_t kFloatResultFlags = 2;

// Every entry below is
//   menu id, display-string id, code, flags, count, types..., title ids...
// and a condition or action parameter p has the title id menu id + 1 + p.

constexpr uint16_t kConditionWords[] = {
    ID_CONDITION_IS_SWINGING, ID_CONDITION_IS_SWINGING, 0, kSwingingConditionFlags, 1, kExpression,
    ID_CONDITION_IS_SWINGING + 1,
    ID_CONDITION_ON_SWING, ID_CONDITION_ON_SWING, 1, 0, 1, kExpression, ID_CONDITION_ON_SWING + 1,
    0};

constexpr uint16_t kActionWords[] = {
    ID_ACTION_ADD_ANCHOR, ID_ACTION_ADD_ANCHOR, 0, 0, 1, kObject, ID_ACTION_ADD_ANCHOR + 1,
    ID_ACTION_ADD_LINK, ID_ACTION_ADD_LINK, 1, 0, 1, kObject, ID_ACTION_ADD_LINK + 1,
    ID_ACTION_ADD_PLATFORM, ID_ACTION_ADD_PLATFORM, 2, 0, 1, kObject, ID_ACTION_ADD_PLATFORM + 1,
    ID_ACTION_SET_ANCHOR_X, ID_ACTION_SET_ANCHOR_X, 3, 0, 2, kExpression, kExpression,
    ID_ACTION_SET_ANCHOR_X + 1, ID_ACTION_SET_ANCHOR_X + 2,
    ID_ACTION_SET_ANCHOR_Y, ID_ACTION_SET_ANCHOR_Y, 4, 0, 2, kExpression, kExpression,
    ID_ACTION_SET_ANCHOR_Y + 1, ID_ACTION_SET_ANCHOR_Y + 2,
    ID_ACTION_SET_MASS, ID_ACTION_SET_MASS, 5, 0, 2, kExpression, kExpression,
    ID_ACTION_SET_MASS + 1, ID_ACTION_SET_MASS + 2,
    ID_ACTION_SET_ANGLE, ID_ACTION_SET_ANGLE, 6, 0, 2, kExpression, kExpression,
    ID_ACTION_SET_ANGLE + 1, ID_ACTION_SET_ANGLE + 2,
    ID_ACTION_SET_SPEED, ID_ACTION_SET_SPEED, 7, 0, 2, kExpression, kExpression,
    ID_ACTION_SET_SPEED + 1, ID_ACTION_SET_SPEED + 2,
    ID_ACTION_SET_LINK_SPACING, ID_ACTION_SET_LINK_SPACING, 8, 0, 2, kExpression, kExpression,
    ID_ACTION_SET_LINK_SPACING + 1, ID_ACTION_SET_LINK_SPACING + 2,
    ID_ACTION_START_ALL, ID_ACTION_START_ALL, 9, 0, 0,
    ID_ACTION_START_CHAIN, ID_ACTION_START_CHAIN, 10, 0, 1, kExpression, ID_ACTION_START_CHAIN + 1,
    ID_ACTION_STOP_ALL, ID_ACTION_STOP_ALL, 11, 0, 0,
    ID_ACTION_STOP_CHAIN, ID_ACTION_STOP_CHAIN, 12, 0, 1, kExpression, ID_ACTION_STOP_CHAIN + 1,
    ID_ACTION_UPDATE_ALL, ID_ACTION_UPDATE_ALL, 13, 0, 0,
    ID_ACTION_UPDATE_CHAIN, ID_ACTION_UPDATE_CHAIN, 14, 0, 1, kExpression, ID_ACTION_UPDATE_CHAIN + 1,
    ID_ACTION_SET_ACCELERATION, ID_ACTION_SET_ACCELERATION, 15, 0, 2, kExpression, kExpression,
    ID_ACTION_SET_ACCELERATION + 1, ID_ACTION_SET_ACCELERATION + 2,
    0};

// Expression parameters have no titles: every title id is 0.
constexpr uint16_t kExpressionWords[] = {
    ID_EXPRESSION_CHAIN_NUM, ID_EXPRESSION_CHAIN_NUM, 0, 0, 0,
    ID_EXPRESSION_CHAIN_LINKS, ID_EXPRESSION_CHAIN_LINKS, 1, 0, 0,
    ID_EXPRESSION_ANCHOR_X, ID_EXPRESSION_ANCHOR_X, 2, 0, 1, kInteger, 0,
    ID_EXPRESSION_ANCHOR_Y, ID_EXPRESSION_ANCHOR_Y, 3, 0, 1, kInteger, 0,
    ID_EXPRESSION_PLATFORM_MASS, ID_EXPRESSION_PLATFORM_MASS, 4, kFloatResultFlags, 1, kInteger, 0,
    ID_EXPRESSION_CHAIN_ANGLE, ID_EXPRESSION_CHAIN_ANGLE, 5, kFloatResultFlags, 1, kInteger, 0,
    ID_EXPRESSION_CHAIN_SPEED, ID_EXPRESSION_CHAIN_SPEED, 6, kFloatResultFlags, 1, kInteger, 0,
    ID_EXPRESSION_LINK_SPACING, ID_EXPRESSION_LINK_SPACING, 7, kFloatResultFlags, 1, kInteger, 0,
    ID_EXPRESSION_PLATFORM_X, ID_EXPRESSION_PLATFORM_X, 8, 0, 1, kInteger, 0,
    ID_EXPRESSION_PLATFORM_Y, ID_EXPRESSION_PLATFORM_Y, 9, 0, 1, kInteger, 0,
    ID_EXPRESSION_CHAIN_INDEX, ID_EXPRESSION_CHAIN_INDEX, 10, 0, 1, kInteger, 0,
    // The delta routines return floats too, but their entries say 0.
    ID_EXPRESSION_DELTA_X, ID_EXPRESSION_DELTA_X, 11, 0, 1, kDeltaInteger, 0,
    ID_EXPRESSION_DELTA_Y, ID_EXPRESSION_DELTA_Y, 12, 0, 1, kDeltaInteger, 0,
    ID_EXPRESSION_CHAIN_ACCEL, ID_EXPRESSION_CHAIN_ACCEL, 13, kFloatResultFlags, 1, kInteger, 0,
    ID_EXPRESSION_LINK_INDEX, ID_EXPRESSION_LINK_INDEX, 14, 0, 1, kInteger, 0,
    ID_EXPRESSION_LINK_X, ID_EXPRESSION_LINK_X, 15, 0, 2, kInteger, kInteger, 0, 0,
    ID_EXPRESSION_LINK_Y, ID_EXPRESSION_LINK_Y, 16, 0, 2, kInteger, kInteger, 0, 0,
    0};

// The host walks the tables by their byte sizes.
static_assert(sizeof kConditionWords == 28 + 2);
static_assert(sizeof kActionWords == 240 + 2);
static_assert(sizeof kExpressionWords == 238 + 2);

// True when the words hold `entries` entries with the codes 0, 1, 2, ... in
// order, each with its display-string id equal to its menu id, at most two
// parameters and the title ids the family gives them (menu id + 1 + p, or
// 0), ending exactly at the closing 0 word.
template <std::size_t N>
constexpr bool IsWellFormed(const uint16_t (&words)[N], int entries, bool titlesFollowMenuId) {
  std::size_t at = 0;
  for (int code = 0; code < entries; ++code) {
    if (at + 5 > N - 1) return false;
    const std::size_t n = words[at + kEntryParameterCount];
    if (n > 2 || at + 5 + 2 * n > N - 1) return false;
    if (words[at + kEntryCode] != code || words[at + kEntryStringId] != words[at + kEntryMenuId]) return false;
    for (std::size_t p = 0; p < n; ++p) {
      const std::size_t expected = titlesFollowMenuId ? words[at + kEntryMenuId] + 1 + p : 0;
      if (words[at + kEntryParameterTypes + n + p] != expected) return false;
    }
    at += 5 + 2 * n;
  }
  return at == N - 1 && words[N - 1] == 0;
}

static_assert(IsWellFormed(kConditionWords, kConditionCount, true));
static_assert(IsWellFormed(kActionWords, kActionCount, true));
static_assert(IsWellFormed(kExpressionWords, kExpressionCount, false));

}  // namespace

const EventFamily kConditionEvents = {kConditionWords, std::size(kConditionWords) - 1, kConditionCount, IDM_CONDITIONS};
const EventFamily kActionEvents = {kActionWords, std::size(kActionWords) - 1, kActionCount, IDM_ACTIONS};
const EventFamily kExpressionEvents = {kExpressionWords, std::size(kExpressionWords) - 1,
                                       kExpressionCount, IDM_EXPRESSIONS};
