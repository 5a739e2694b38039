// The names under which a scene refers to the library's actions and
// expressions: the texts the host's event editor shows for them. The code of
// each is its position in the library's routine table.
#pragma once

#include <string_view>

namespace scene_player {

// How the host hands an action parameter to the routine: an object of the
// frame, or an expression's value, read as an integer or (for the setters of
// float fields) again as a float.
enum class ParamKind { Object, Integer, Float };

struct ActionName {
  const char* menuText;  // null for the action that has no menu item
  const char* displayText;
  int paramCount;
  ParamKind kinds[2];
  const char* titles[2];
};

struct ExpressionName {
  const char* menuText;
  const char* displayText;  // the name followed by "("
  int paramCount;
};

constexpr int kActionNameCount = 16;
constexpr int kExpressionNameCount = 17;

extern const ActionName kActionNames[kActionNameCount];
extern const ExpressionName kExpressionNames[kExpressionNameCount];

// The code named by a menu text or display text; blanks around the name are
// ignored, so "Set Anchor X" finds the menu text "Set Anchor X ". -1 when no
// action or expression has that name.
int FindAction(std::string_view name);
int FindExpression(std::string_view name);

}  // namespace scene_player
