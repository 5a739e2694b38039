#include "event_names.h"

namespace scene_player {

namespace {

constexpr ParamKind O = ParamKind::Object;
constexpr ParamKind I = ParamKind::Integer;
constexpr ParamKind F = ParamKind::Float;

std::string_view Trimmed(std::string_view text) {
  const auto first = text.find_first_not_of(' ');
  if (first == std::string_view::npos) return {};
  return text.substr(first, text.find_last_not_of(' ') - first + 1);
}

bool Names(const char* text, std::string_view wanted) {
  return text != nullptr && Trimmed(text) == wanted;
}

}  // namespace

const ActionName kActionNames[kActionNameCount] = {
    {"Add Anchor", "Add Anchor %0", 1, {O, I}, {"Anchor Object", nullptr}},
    {"Add Link", "Add Link  %0", 1, {O, I}, {"Link Object", nullptr}},
    {"Add Platform", "Add Platform  %0", 1, {O, I}, {"Platform Object", nullptr}},
    {"Set Anchor X ", "Set Anchor X at index %0 to %1", 2, {I, I}, {"Chain Index", "X Position"}},
    {"Set Anchor Y", "Set Anchor Y at index %0 to %1", 2, {I, I}, {"Chain Index", "Y Position"}},
    {"Set Mass", "Set Mass at index %0 to %1", 2, {I, F}, {"Chain Index", "Mass"}},
    {"Set Angle", "Set Angle at index %0 to %1", 2, {I, F}, {"Chain Index", "Angle"}},
    {nullptr, "Set Speed at index %0 to %1", 2, {I, F}, {"Chain Index", "Speed"}},
    {"Set Link Spacing", "Set Link Spacing at index %0 to %1", 2, {I, F}, {"Chain Index", "Link Spacing"}},
    {"Start All", "Start All", 0, {I, I}, {nullptr, nullptr}},
    {"Start Chain", "Start Chain at index %0", 1, {I, I}, {"Chain Index", nullptr}},
    {"Stop All", "Stop All", 0, {I, I}, {nullptr, nullptr}},
    {"Stop Chain", "Stop Chain at index %0", 1, {I, I}, {"Chain Index", nullptr}},
    {"Update All", "Update All", 0, {I, I}, {nullptr, nullptr}},
    {"Update Chain", "Update Chain at index %0", 1, {I, I}, {"Chain Index", nullptr}},
    {"Set Acceleration", "Set Acceleration at index %0 to %1", 2, {I, F}, {"Chain Index", "Acceleration"}},
};

const ExpressionName kExpressionNames[kExpressionNameCount] = {
    {"Get number of chains", "ChainNum(", 0},
    {"Get number of links per chain", "ChainLinks(", 0},
    {"Get Anchor X", "AnchorX(", 1},
    {"Get Anchor Y", "AnchorY(", 1},
    {"Get Platform Mass", "PlatformMass(", 1},
    {"Get Chain Angle", "ChainAngle(", 1},
    {"Get Chain Speed", "ChainSpeed(", 1},
    {"Get Link Spacing", "LinkSpacing(", 1},
    {"Get Platform X", "PlatformX(", 1},
    {"Get Platform Y", "PlatformY(", 1},
    {"Get Chain Index", "ChainIndex(", 1},
    {"Get DeltaX", "DeltaX(", 1},
    {"Get DeltaY", "DeltaY(", 1},
    {"Get Chain Acceleration", "ChainAccel(", 1},
    {"Get Link Index", "LinkIndex(", 1},
    {"Get Link X", "LinkX(", 2},
    {"Get Link Y", "LinkY(", 2},
};

int FindAction(std::string_view name) {
  const std::string_view wanted = Trimmed(name);
  for (int code = 0; code < kActionNameCount; ++code) {
    if (Names(kActionNames[code].menuText, wanted) || Names(kActionNames[code].displayText, wanted)) return code;
  }
  return -1;
}

int FindExpression(std::string_view name) {
  const std::string_view wanted = Trimmed(name);
  for (int code = 0; code < kExpressionNameCount; ++code) {
    if (Names(kExpressionNames[code].menuText, wanted) || Names(kExpressionNames[code].displayText, wanted)) {
      return code;
    }
  }
  return -1;
}

}  // namespace scene_player
