// A scene as the player runs it: the object's settings, the host objects of
// the frame, a timeline of steps at given frames, the "On Swing" rules and
// how to draw it all. Every name is resolved and every value checked when
// the scene is read, so playing it cannot meet bad input.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace scene_player {

struct Colour {
  uint8_t r = 0, g = 0, b = 0;
  friend bool operator==(const Colour&, const Colour&) = default;
};

// The four settings exactly as the setup dialog stores them: texts.
struct Settings {
  std::string startAngle = "90";
  std::string mass = "1";
  std::string gravity = "9.81";
  std::string linkSpacing = "0";
};

struct ObjectSpec {
  std::string name;
  std::string place;  // where it is defined in the scene file, for messages
  int32_t x = 0, y = 0;
  int32_t width = 0, height = 0;  // the library knows the height; the width is only drawn
  Colour colour;
  int16_t idLow = 0;
  uint16_t idHigh = 0;
  bool atStart = true;  // false: created later by a "create" step
  // The first object of the scene with this name: a name freed by "destroy"
  // may be given to a later "create", and a step then means whichever of
  // them is on the frame.
  int firstOfName = 0;
};

// A number given in the scene, an expression of the library evaluated each
// time the step runs, or a count: `plus` + `times` x the frame number or the
// repetition of a repeating timeline entry (0 at its first frame).
struct Value {
  enum class Count { None, Frame, Repetition };
  double number = 0.0;
  int expression = -1;  // expression code; -1 for a plain number or a count
  std::vector<Value> params;
  Count count = Count::None;
  double times = 1.0, plus = 0.0;
};

struct Step {
  enum class Kind { Action, Create, Destroy, MoveTo, MoveBy, Enable, Disable };
  Kind kind = Kind::Action;
  std::string place;        // where it stands in the scene file
  int action = -1;          // Action: the action's code
  int object = -1;          // index into Scene::objects: the object acted on or passed
  int rule = -1;            // Enable, Disable: index into Scene::rules
  std::vector<Value> values;  // an action's number parameters, or a move's x and y
};

// Runs its steps at `frame`, and when `every` is not 0 again every `every`
// frames up to `last`.
struct TimelineEntry {
  int frame = 0;
  int every = 0;
  int last = 0;
  std::vector<Step> steps;
};

// Runs its steps whenever "On Swing %0" is true for `chain`, while it is
// enabled.
struct SwingRule {
  std::string name;  // may be empty: then no step can switch it
  int32_t chain = 0;
  bool enabled = true;
  std::vector<Step> steps;
};

struct Scene {
  Settings settings;
  int width = 640, height = 360;
  Colour background{32, 40, 48};
  int frames = 0;
  int frameDelay = 2;  // hundredths of a second per GIF frame
  int trail = 40;      // frames for which a platform's past positions stay drawn
  std::vector<ObjectSpec> objects;
  std::vector<TimelineEntry> timeline;  // in the order of the file
  std::vector<SwingRule> rules;
};

}  // namespace scene_player
