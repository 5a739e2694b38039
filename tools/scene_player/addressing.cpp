#include "addressing.h"

#include <cstring>

#include "event_names.h"
#include "messages.h"
#include "shown_text.h"

namespace scene_player {

namespace {

// Expression codes whose parameters are not a chain index alone.
constexpr int kPlatformX = 8, kPlatformY = 9, kChainIndex = 10, kLinkIndex = 14, kLinkX = 15, kLinkY = 16;

// Why `index` addresses none of `count` things (of chain `ofChain`, when it
// is one), or an empty text. Nothing is written for an index that is there,
// which is what every step of most scenes asks for.
std::string Missing(int32_t index, uint32_t count, const char* thing, int32_t ofChain = -1) {
  if (index >= 0 && static_cast<uint32_t>(index) < count) return "";
  std::string asked = std::string(thing) + " " + std::to_string(index);
  if (ofChain >= 0) asked += " of chain " + std::to_string(ofChain);
  if (index < 0) return asked + ", but " + thing + " numbers count from 0";
  if (count == 0) return asked + ", but there is no " + thing + " at that moment";
  if (count == 1) return asked + ", but there is only " + thing + " 0 at that moment";
  return asked + ", but there are only " + Counted(count, thing) + " (0 to " + std::to_string(count - 1) +
         ") at that moment";
}

}  // namespace

std::string MissedByAction(const RunData& rd, int code, int32_t first) {
  const ActionName& action = kActionNames[code];
  if (action.paramCount == 0 || action.titles[0] == nullptr || std::strcmp(action.titles[0], "Chain Index") != 0) {
    return "";
  }
  const std::string missing = Missing(first, ChainCount(rd), "chain");
  if (missing.empty()) return "";
  return tool_input::Quoted(action.menuText ? action.menuText : action.displayText) + " addresses " + missing +
         ": it does nothing";
}

std::string MissedByExpression(const RunData& rd, int code, const int32_t (&params)[2]) {
  const ExpressionName& expression = kExpressionNames[code];
  std::string missing;
  std::string answer = "it answers 0";
  if (code == kPlatformX || code == kPlatformY) {
    missing = Missing(params[0], PlatformCount(rd), "platform");
    answer = "it answers the position of the extension's own object";
  } else if (code == kLinkX || code == kLinkY) {
    missing = Missing(params[0], ChainCount(rd), "chain");
    if (missing.empty()) {
      missing = Missing(params[1], LinksPerChain(rd), "link", params[0]);
    }
  } else if (expression.paramCount == 1 && code != kChainIndex && code != kLinkIndex) {
    missing = Missing(params[0], ChainCount(rd), "chain");
  }
  if (missing.empty()) return "";
  return tool_input::Quoted(expression.displayText) + " asks for " + missing + ": " + answer;
}

}  // namespace scene_player
