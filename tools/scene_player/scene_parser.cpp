#include "scene_parser.h"

#include <algorithm>
#include <cctype>
#include <cmath>
#include <cstdint>
#include <initializer_list>
#include <map>
#include <utility>
#include <nlohmann/json.hpp>

#include "event_names.h"
#include "json_document.h"
#include "palette.h"
#include "shown_text.h"

namespace scene_player {

namespace {

using nlohmann::json;

constexpr int kMaxFrames = 100000;
constexpr int kMaxCanvasSide = 4096;
constexpr int kMaxObjects = 30000;  // default identifiers 1..n stay in the low half
constexpr int32_t kMaxObjectSide = 100000;
constexpr int kMaxExpressionDepth = 16;
constexpr std::size_t kSettingTextLength = 9;  // the stored field holds 9 characters and a terminator

[[noreturn]] void Fail(const std::string& place, const std::string& message) {
  throw SceneError(place.empty() ? "top level" : place, message);
}

using tool_input::Quoted;

// How a value found in the file is named in a message.
std::string Described(const json& value) {
  switch (value.type()) {
    case json::value_t::object: return "an object";
    case json::value_t::array: return "an array";
    case json::value_t::string: {
      const auto& text = value.get_ref<const std::string&>();
      return "the text " + Quoted(text);
    }
    case json::value_t::boolean: return value.get<bool>() ? "true" : "false";
    case json::value_t::null: return "null";
    default: return value.dump();
  }
}

[[noreturn]] void Expected(const std::string& place, const std::string& what, const json& found) {
  Fail(place, "expected " + what + ", found " + Described(found));
}

void RequireObject(const json& value, const std::string& place, const std::string& what) {
  if (!value.is_object()) Expected(place, what, value);
}

void RequireArray(const json& value, const std::string& place, const std::string& what) {
  if (!value.is_array()) Expected(place, what, value);
}

// Rejects keys the format does not have, which are most often typing errors.
void CheckKeys(const json& object, const std::string& place, std::initializer_list<const char*> known) {
  for (const auto& item : object.items()) {
    if (std::find_if(known.begin(), known.end(), [&](const char* k) { return item.key() == k; }) != known.end()) {
      continue;
    }
    std::string list;
    for (const char* k : known) list += (list.empty() ? "" : ", ") + Quoted(k);
    Fail(place, "unknown key " + Quoted(item.key()) + "; expected one of " + list);
  }
}

const json* Find(const json& object, const char* key) {
  const auto it = object.find(key);
  return it == object.end() ? nullptr : &*it;
}

const json& Require(const json& object, const std::string& place, const char* key, const std::string& what) {
  const json* value = Find(object, key);
  if (value == nullptr) Fail(place, "missing " + Quoted(key) + ": expected " + what);
  return *value;
}

int64_t WholeNumber(const json& value, const std::string& place, int64_t min, int64_t max, const std::string& what) {
  const std::string expected = what + ", a whole number from " + std::to_string(min) + " to " + std::to_string(max);
  if (!value.is_number()) Expected(place, expected, value);
  const double number = value.get<double>();
  if (number != std::trunc(number) || number < static_cast<double>(min) || number > static_cast<double>(max)) {
    Expected(place, expected, value);
  }
  return static_cast<int64_t>(number);
}

int64_t OptionalWholeNumber(const json& object, const std::string& place, const char* key, int64_t fallback,
                            int64_t min, int64_t max, const std::string& what) {
  const json* value = Find(object, key);
  return value ? WholeNumber(*value, Member(place, key), min, max, what) : fallback;
}

const std::string& Text(const json& value, const std::string& place, const std::string& what) {
  if (!value.is_string()) Expected(place, what, value);
  return value.get_ref<const std::string&>();
}

Colour ParseColour(const json& value, const std::string& place) {
  const std::string what = "a colour written \"#rrggbb\" in hexadecimal";
  const std::string& text = Text(value, place, what);
  if (text.size() != 7 || text[0] != '#' ||
      !std::all_of(text.begin() + 1, text.end(), [](char c) { return std::isxdigit(static_cast<unsigned char>(c)); })) {
    Expected(place, what, value);
  }
  auto channel = [&](int at) { return static_cast<uint8_t>(std::stoi(text.substr(at, 2), nullptr, 16)); };
  return {channel(1), channel(3), channel(5)};
}

std::string ParamList(const ActionName& action) {
  if (action.paramCount == 0) return "no parameter";
  std::string list = std::to_string(action.paramCount) + (action.paramCount == 1 ? " parameter (" : " parameters (");
  for (int p = 0; p < action.paramCount; ++p) list += (p ? ", " : "") + std::string(action.titles[p]);
  return list + ")";
}

std::string ActionLabel(int code) {
  const ActionName& action = kActionNames[code];
  return Quoted(action.menuText ? action.menuText : action.displayText);
}

// Where a step stands, which decides what it may do: an entry of the
// timeline that runs once, one that repeats, or an "On Swing" rule.
enum class Where { Once, Repeating, Rule };

// What a scene knows about an object name while its timeline is read in
// frame order.
struct NameState {
  int object = -1;           // index into Scene::objects once defined
  std::string createdAt;     // the "create" step that defines it, if any
  std::string destroyedAt;   // the timeline step that destroyed it, if any
};

class Reader {
 public:
  Scene Read(const json& root);

 private:
  void ReadSettings(const json& root);
  void ReadCanvas(const json& root);
  ObjectSpec ReadObject(const json& value, const std::string& place, bool atStart);
  void Define(ObjectSpec spec);
  void CollectCreatedNames(const json& timeline);
  void ReadTimeline(const json& root);
  TimelineEntry ReadEntryFrames(const json& entry, const std::string& place);
  void ReadRules(const json& root);
  void ReadRuleSteps(const json& root);
  std::vector<Step> ReadSteps(const json& value, const std::string& place, Where where);
  Step ReadStep(const json& value, const std::string& place, Where where);
  Step ReadAction(const json& value, const std::string& place, Where where);
  Step ReadMove(const json& value, const std::string& place, Where where);
  int ObjectNamed(const json& value, const std::string& place, Where where);
  int RuleNamed(const json& value, const std::string& place);
  Value ReadValue(const json& value, const std::string& place, ParamKind kind, Where where, int depth = 0);
  Value ReadCount(const json& value, const std::string& place, Where where);

  Scene scene_;
  std::map<std::string, NameState> names_;
  std::map<std::string, int> ruleNames_;
};

Scene Reader::Read(const json& root) {
  RequireObject(root, "", "a scene: an object with \"frames\", \"objects\", \"timeline\" and more");
  CheckKeys(root, "", {"settings", "canvas", "frames", "frameDelay", "trail", "objects", "timeline", "onSwing"});
  ReadSettings(root);
  ReadCanvas(root);
  scene_.frames = static_cast<int>(WholeNumber(Require(root, "", "frames", "the number of frames to play"), "frames",
                                               1, kMaxFrames, "the number of frames to play"));
  scene_.frameDelay = static_cast<int>(OptionalWholeNumber(root, "", "frameDelay", scene_.frameDelay, 1, 65535,
                                                           "hundredths of a second per frame"));
  scene_.trail = static_cast<int>(
      OptionalWholeNumber(root, "", "trail", scene_.trail, 0, kMaxFrames, "the number of frames a trail lasts"));

  if (const json* objects = Find(root, "objects")) {
    RequireArray(*objects, "objects", "an array of objects");
    for (std::size_t i = 0; i < objects->size(); ++i) Define(ReadObject((*objects)[i], Element("objects", i), true));
  }
  // Rules are read before the timeline, which may switch them by name, and
  // their steps after it, which may name objects that it creates.
  ReadRules(root);
  ReadTimeline(root);
  ReadRuleSteps(root);

  if (PaletteSize(scene_) > kMaxPaletteColours) {
    Fail("objects", "the objects' colours and their trail shades make " + std::to_string(PaletteSize(scene_)) +
                        " colours; expected at most " + std::to_string(kMaxPaletteColours) +
                        " (a GIF frame holds no more): use fewer distinct colours");
  }
  return std::move(scene_);
}

void Reader::ReadSettings(const json& root) {
  const json* settings = Find(root, "settings");
  if (settings == nullptr) return;
  RequireObject(*settings, "settings", "an object with the texts \"startAngle\", \"mass\", \"gravity\", \"linkSpacing\"");
  CheckKeys(*settings, "settings", {"startAngle", "mass", "gravity", "linkSpacing"});
  const std::pair<const char*, std::string*> fields[] = {{"startAngle", &scene_.settings.startAngle},
                                                         {"mass", &scene_.settings.mass},
                                                         {"gravity", &scene_.settings.gravity},
                                                         {"linkSpacing", &scene_.settings.linkSpacing}};
  for (const auto& [key, field] : fields) {
    const json* value = Find(*settings, key);
    if (value == nullptr) continue;
    const std::string place = Member("settings", key);
    const std::string what = "the setting as the setup dialog stores it: a text of at most 9 characters";
    const std::string& text = Text(*value, place, what);
    if (text.size() > kSettingTextLength || text.find('\0') != std::string::npos) Expected(place, what, *value);
    *field = text;
  }
}

void Reader::ReadCanvas(const json& root) {
  const json* canvas = Find(root, "canvas");
  if (canvas == nullptr) return;
  RequireObject(*canvas, "canvas", "an object with \"width\", \"height\" and \"background\"");
  CheckKeys(*canvas, "canvas", {"width", "height", "background"});
  scene_.width = static_cast<int>(
      OptionalWholeNumber(*canvas, "canvas", "width", scene_.width, 1, kMaxCanvasSide, "the picture's width"));
  scene_.height = static_cast<int>(
      OptionalWholeNumber(*canvas, "canvas", "height", scene_.height, 1, kMaxCanvasSide, "the picture's height"));
  if (const json* background = Find(*canvas, "background")) {
    scene_.background = ParseColour(*background, "canvas.background");
  }
}

ObjectSpec Reader::ReadObject(const json& value, const std::string& place, bool atStart) {
  RequireObject(value, place, "an object with \"name\", \"x\", \"y\", \"width\" and \"height\"");
  CheckKeys(value, place, {"name", "x", "y", "width", "height", "colour", "idLow", "idHigh"});
  ObjectSpec spec;
  spec.place = place;
  spec.atStart = atStart;
  spec.name = Text(Require(value, place, "name", "the object's name"), Member(place, "name"), "the object's name");
  if (spec.name.empty()) Fail(Member(place, "name"), "expected the object's name, found an empty text");
  auto coordinate = [&](const char* key, const char* what) {
    return static_cast<int32_t>(
        WholeNumber(Require(value, place, key, what), Member(place, key), INT32_MIN, INT32_MAX, what));
  };
  auto side = [&](const char* key, const char* what) {
    return static_cast<int32_t>(
        WholeNumber(Require(value, place, key, what), Member(place, key), 0, kMaxObjectSide, what));
  };
  spec.x = coordinate("x", "the x of the object's centre");
  spec.y = coordinate("y", "the y of the object's centre (y grows downwards)");
  spec.width = side("width", "the object's width in pixels");
  spec.height = side("height", "the object's height in pixels");
  spec.colour = Colour{200, 200, 200};
  if (const json* colour = Find(value, "colour")) spec.colour = ParseColour(*colour, Member(place, "colour"));
  // By default every object gets its own identifier: its number in the scene.
  spec.idLow = static_cast<int16_t>(OptionalWholeNumber(value, place, "idLow",
                                                        static_cast<int64_t>(scene_.objects.size()) + 1, INT16_MIN,
                                                        INT16_MAX, "the low half of the object identifier"));
  spec.idHigh = static_cast<uint16_t>(
      OptionalWholeNumber(value, place, "idHigh", 0, 0, UINT16_MAX, "the high half of the object identifier"));
  return spec;
}

// A name is free again once the timeline has destroyed its object, so that a
// rebuild may use the names it had.
void Reader::Define(ObjectSpec spec) {
  NameState& state = names_[spec.name];
  if (state.object >= 0 && state.destroyedAt.empty()) {
    Fail(Member(spec.place, "name"), "the name " + Quoted(spec.name) + " is already taken by " +
                                         scene_.objects[state.object].place +
                                         "; expected a name of its own, or a \"destroy\" of that object first");
  }
  if (scene_.objects.size() >= kMaxObjects) {
    Fail(spec.place, "too many objects; expected at most " + std::to_string(kMaxObjects));
  }
  const int index = static_cast<int>(scene_.objects.size());
  spec.firstOfName = state.object >= 0 ? scene_.objects[state.object].firstOfName : index;
  state.object = index;
  state.destroyedAt.clear();
  scene_.objects.push_back(std::move(spec));
}

// The timeline runs in frame order, which need not be the order of the file:
// to tell "used before it exists" from "no such object", the names that
// "create" steps define are noted first.
void Reader::CollectCreatedNames(const json& timeline) {
  for (std::size_t i = 0; i < timeline.size(); ++i) {
    const json* steps = timeline[i].is_object() ? Find(timeline[i], "do") : nullptr;
    if (steps == nullptr || !steps->is_array()) continue;
    for (std::size_t k = 0; k < steps->size(); ++k) {
      const json& step = (*steps)[k];
      const json* created = step.is_object() ? Find(step, "create") : nullptr;
      const json* name = created && created->is_object() ? Find(*created, "name") : nullptr;
      if (name == nullptr || !name->is_string()) continue;
      NameState& state = names_[name->get<std::string>()];
      if (state.createdAt.empty()) state.createdAt = Element(Element("timeline", i) + ".do", k);
    }
  }
}

void Reader::ReadTimeline(const json& root) {
  const json* timeline = Find(root, "timeline");
  if (timeline == nullptr) return;
  RequireArray(*timeline, "timeline", "an array of entries, each with a \"frame\" and the steps to \"do\"");
  std::vector<TimelineEntry> entries;
  for (std::size_t i = 0; i < timeline->size(); ++i) {
    const std::string place = Element("timeline", i);
    const json& entry = (*timeline)[i];
    entries.push_back(ReadEntryFrames(entry, place));
    RequireArray(Require(entry, place, "do", "an array of steps"), Member(place, "do"), "an array of steps");
  }
  CollectCreatedNames(*timeline);

  // Names are checked in the order the entries first run.
  std::vector<std::size_t> order(timeline->size());
  for (std::size_t i = 0; i < order.size(); ++i) order[i] = i;
  std::stable_sort(order.begin(), order.end(),
                   [&](std::size_t a, std::size_t b) { return entries[a].frame < entries[b].frame; });
  for (std::size_t i : order) {
    TimelineEntry& entry = entries[i];
    const std::string place = Member(Element("timeline", i), "do");
    entry.steps = ReadSteps((*timeline)[i]["do"], place, entry.every ? Where::Repeating : Where::Once);
  }
  scene_.timeline = std::move(entries);
}

// An entry runs once at its "frame", or from "from" to "to" "every" so many
// frames.
TimelineEntry Reader::ReadEntryFrames(const json& entry, const std::string& place) {
  RequireObject(entry, place, "an entry with a \"frame\" (or \"every\", \"from\" and \"to\") and the steps to \"do\"");
  CheckKeys(entry, place, {"frame", "every", "from", "to", "do"});
  const int lastFrame = scene_.frames - 1;
  TimelineEntry result;
  if (Find(entry, "frame")) {
    if (Find(entry, "every") || Find(entry, "from") || Find(entry, "to")) {
      Fail(place, "expected either \"frame\" for steps that run once, or \"every\" with \"from\" and \"to\" for "
                  "steps that repeat, not both");
    }
    const std::string what = "the frame at which the steps run (the first frame is 0)";
    result.frame = static_cast<int>(WholeNumber(entry["frame"], Member(place, "frame"), 0, lastFrame, what));
    return result;
  }
  if (!Find(entry, "every")) {
    Fail(place, "missing \"frame\": expected the frame at which the steps run, or \"every\" with \"from\" and \"to\" "
                "for steps that repeat");
  }
  result.every = static_cast<int>(WholeNumber(entry["every"], Member(place, "every"), 1, kMaxFrames,
                                              "the number of frames from one repetition to the next"));
  const std::string fromWhat = "the first frame at which the steps run";
  result.frame = static_cast<int>(
      WholeNumber(Require(entry, place, "from", fromWhat), Member(place, "from"), 0, lastFrame, fromWhat));
  result.last = static_cast<int>(OptionalWholeNumber(entry, place, "to", lastFrame, result.frame, lastFrame,
                                                     "the last frame at which the steps may run"));
  return result;
}

void Reader::ReadRules(const json& root) {
  const json* rules = Find(root, "onSwing");
  if (rules == nullptr) return;
  RequireArray(*rules, "onSwing", "an array of rules, each with a \"chain\" and the steps to \"do\"");
  for (std::size_t i = 0; i < rules->size(); ++i) {
    const std::string place = Element("onSwing", i);
    const json& rule = (*rules)[i];
    RequireObject(rule, place, "a rule with a \"chain\" index and the steps to \"do\"");
    CheckKeys(rule, place, {"name", "chain", "enabled", "do"});
    const std::string what = "the index of the chain whose swing runs the steps";
    SwingRule parsed;
    parsed.chain = static_cast<int32_t>(
        WholeNumber(Require(rule, place, "chain", what), Member(place, "chain"), INT32_MIN, INT32_MAX, what));
    if (const json* name = Find(rule, "name")) {
      const std::string namePlace = Member(place, "name");
      parsed.name = Text(*name, namePlace, "the rule's name, for the steps that switch it on and off");
      if (parsed.name.empty()) Fail(namePlace, "expected the rule's name, found an empty text");
      const auto [it, added] = ruleNames_.emplace(parsed.name, static_cast<int>(i));
      if (!added) {
        Fail(namePlace, "the name " + Quoted(parsed.name) + " is already taken by " + Element("onSwing", it->second) +
                            "; expected a name of its own");
      }
    }
    if (const json* enabled = Find(rule, "enabled")) {
      if (!enabled->is_boolean()) Expected(Member(place, "enabled"), "true or false", *enabled);
      parsed.enabled = enabled->get<bool>();
    }
    RequireArray(Require(rule, place, "do", "an array of steps"), Member(place, "do"), "an array of steps");
    scene_.rules.push_back(std::move(parsed));
  }
}

void Reader::ReadRuleSteps(const json& root) {
  for (std::size_t i = 0; i < scene_.rules.size(); ++i) {
    scene_.rules[i].steps = ReadSteps(root["onSwing"][i]["do"], Member(Element("onSwing", i), "do"), Where::Rule);
  }
}

std::vector<Step> Reader::ReadSteps(const json& value, const std::string& place, Where where) {
  std::vector<Step> steps;
  for (std::size_t k = 0; k < value.size(); ++k) steps.push_back(ReadStep(value[k], Element(place, k), where));
  return steps;
}

Step Reader::ReadStep(const json& value, const std::string& place, Where where) {
  const std::string what =
      "a step: an object with one of \"action\", \"create\", \"destroy\", \"move\", \"enable\" or \"disable\"";
  RequireObject(value, place, what);
  int kinds = 0;
  for (const char* key : {"action", "create", "destroy", "move", "enable", "disable"}) kinds += Find(value, key) ? 1 : 0;
  if (kinds != 1) {
    Fail(place, "expected exactly one of \"action\", \"create\", \"destroy\", \"move\", \"enable\" or \"disable\" "
                "in a step");
  }

  if (Find(value, "action")) return ReadAction(value, place, where);
  if (Find(value, "move")) return ReadMove(value, place, where);

  Step step;
  step.place = place;
  for (const auto& [key, kind] : {std::pair{"enable", Step::Kind::Enable}, std::pair{"disable", Step::Kind::Disable}}) {
    if (const json* rule = Find(value, key)) {
      CheckKeys(value, place, {key});
      step.kind = kind;
      step.rule = RuleNamed(*rule, Member(place, key));
      return step;
    }
  }
  if (const json* created = Find(value, "create")) {
    CheckKeys(value, place, {"create"});
    if (where == Where::Rule) {
      Fail(place, "a rule runs at every swing, so it cannot create an object; expected \"create\" in the timeline");
    }
    if (where == Where::Repeating) {
      Fail(place, "a repeating entry runs many times, so it cannot create an object; expected \"create\" in an entry "
                  "with \"frame\"");
    }
    step.kind = Step::Kind::Create;
    ObjectSpec spec = ReadObject(*created, Member(place, "create"), false);
    step.object = static_cast<int>(scene_.objects.size());
    Define(std::move(spec));
    return step;
  }
  CheckKeys(value, place, {"destroy"});
  step.kind = Step::Kind::Destroy;
  step.object = ObjectNamed(value["destroy"], Member(place, "destroy"), where);
  if (where != Where::Rule) names_[scene_.objects[step.object].name].destroyedAt = place;
  return step;
}

int Reader::RuleNamed(const json& value, const std::string& place) {
  const std::string& name = Text(value, place, "a rule's name");
  const auto it = ruleNames_.find(name);
  if (it == ruleNames_.end()) {
    Fail(place, "no rule named " + Quoted(name) + "; expected the \"name\" of a rule in \"onSwing\"");
  }
  return it->second;
}

Step Reader::ReadAction(const json& value, const std::string& place, Where where) {
  CheckKeys(value, place, {"action", "params"});
  const std::string what = "an action's menu text such as \"Start Chain\" or its display text such as "
                           "\"Start Chain at index %0\"";
  const std::string& name = Text(value["action"], Member(place, "action"), what);
  Step step;
  step.place = place;
  step.action = FindAction(name);
  if (step.action < 0) Fail(place, "unknown action " + Quoted(name) + "; expected " + what);
  const ActionName& action = kActionNames[step.action];

  const json* params = Find(value, "params");
  if (params == nullptr) {
    if (action.paramCount > 0) Fail(place, "missing \"params\": " + ActionLabel(step.action) + " takes " + ParamList(action));
    return step;
  }
  const std::string paramsPlace = Member(place, "params");
  RequireArray(*params, paramsPlace, "an array of the action's parameters");
  if (params->size() != static_cast<std::size_t>(action.paramCount)) {
    Fail(paramsPlace, ActionLabel(step.action) + " takes " + ParamList(action) + ", found " +
                          std::to_string(params->size()));
  }
  for (int p = 0; p < action.paramCount; ++p) {
    const std::string paramPlace = Element(paramsPlace, static_cast<std::size_t>(p));
    if (action.kinds[p] == ParamKind::Object) {
      step.object = ObjectNamed((*params)[p], paramPlace, where);
    } else {
      step.values.push_back(ReadValue((*params)[p], paramPlace, action.kinds[p], where));
    }
  }
  return step;
}

Step Reader::ReadMove(const json& value, const std::string& place, Where where) {
  CheckKeys(value, place, {"move", "to", "by"});
  Step step;
  step.place = place;
  step.object = ObjectNamed(value["move"], Member(place, "move"), where);
  const json* to = Find(value, "to");
  const json* by = Find(value, "by");
  if ((to == nullptr) == (by == nullptr)) {
    Fail(place, "expected exactly one of \"to\" (a position) or \"by\" (a distance) in a move");
  }
  step.kind = to ? Step::Kind::MoveTo : Step::Kind::MoveBy;
  const std::string pairPlace = Member(place, to ? "to" : "by");
  const json& pair = to ? *to : *by;
  const std::string what = "an array of two values, x and y";
  if (!pair.is_array() || pair.size() != 2) Expected(pairPlace, what, pair);
  for (std::size_t i = 0; i < 2; ++i) step.values.push_back(ReadValue(pair[i], Element(pairPlace, i), ParamKind::Float, where));
  return step;
}

int Reader::ObjectNamed(const json& value, const std::string& place, Where where) {
  const std::string& name = Text(value, place, "an object's name");
  const auto it = names_.find(name);
  const NameState* state = it == names_.end() ? nullptr : &it->second;
  if (state == nullptr || (state->object < 0 && state->createdAt.empty())) {
    Fail(place, "no object named " + Quoted(name) + "; expected the name of an object in \"objects\" or made by a "
                "\"create\" step");
  }
  // A rule runs whenever its chain swings; the object may or may not exist
  // then, and the step does nothing while it does not.
  if (where == Where::Rule) return state->object;
  if (state->object < 0) {
    Fail(place, "object " + Quoted(name) + " is used before it exists; it is created at " + state->createdAt +
                    ", expected a step at a later frame, or later in the same frame");
  }
  if (!state->destroyedAt.empty()) {
    Fail(place, "object " + Quoted(name) + " no longer exists: " + state->destroyedAt +
                    " destroyed it; expected an object that is still on the frame");
  }
  return state->object;
}

Value Reader::ReadValue(const json& value, const std::string& place, ParamKind kind, Where where, int depth) {
  Value result;
  if (value.is_number()) {
    if (kind == ParamKind::Integer) {
      result.number = static_cast<double>(WholeNumber(value, place, INT32_MIN, INT32_MAX, "an integer"));
    } else {
      result.number = value.get<double>();
    }
    return result;
  }
  const std::string what =
      std::string(kind == ParamKind::Integer ? "an integer, or an expression such as {\"expression\": \"ChainNum(\"}"
                                             : "a number, or an expression such as {\"expression\": \"DeltaX(\", \"params\": [0]}") +
      ", or a count such as {\"count\": \"frame\", \"times\": 2}";
  if (value.is_object() && Find(value, "count")) return ReadCount(value, place, where);
  if (!value.is_object() || !Find(value, "expression")) Expected(place, what, value);
  CheckKeys(value, place, {"expression", "params"});
  if (depth >= kMaxExpressionDepth) Fail(place, "expressions nested too deeply; expected at most 16 levels");
  const std::string nameWhat = "an expression's name such as \"DeltaX(\" or its menu text such as \"Get DeltaX\"";
  const std::string& name = Text(value["expression"], Member(place, "expression"), nameWhat);
  result.expression = FindExpression(name);
  if (result.expression < 0) Fail(place, "unknown expression " + Quoted(name) + "; expected " + nameWhat);
  const ExpressionName& expression = kExpressionNames[result.expression];
  const json* params = Find(value, "params");
  if (params) RequireArray(*params, Member(place, "params"), "an array of the expression's parameters");
  const std::size_t count = params ? params->size() : 0;
  if (count != static_cast<std::size_t>(expression.paramCount)) {
    Fail(params ? Member(place, "params") : place,
         Quoted(expression.displayText) + " takes " + std::to_string(expression.paramCount) + " parameter" +
             (expression.paramCount == 1 ? "" : "s") + ", found " + std::to_string(count));
  }
  for (std::size_t i = 0; i < count; ++i) {
    result.params.push_back(
        ReadValue((*params)[i], Element(Member(place, "params"), i), ParamKind::Integer, where, depth + 1));
  }
  return result;
}

Value Reader::ReadCount(const json& value, const std::string& place, Where where) {
  CheckKeys(value, place, {"count", "times", "plus"});
  Value result;
  const std::string countPlace = Member(place, "count");
  const std::string what = "\"frame\" (the frame number) or \"repetition\" (0, 1, 2... in a repeating entry)";
  const std::string& count = Text(value["count"], countPlace, what);
  if (count == "frame") {
    result.count = Value::Count::Frame;
  } else if (count == "repetition") {
    if (where != Where::Repeating) {
      Fail(countPlace, "only a repeating entry counts repetitions; expected it in an entry with \"every\", or "
                       "{\"count\": \"frame\"}");
    }
    result.count = Value::Count::Repetition;
  } else {
    Expected(countPlace, what, value["count"]);
  }
  for (const auto& [key, field] : {std::pair{"times", &result.times}, std::pair{"plus", &result.plus}}) {
    if (const json* number = Find(value, key)) {
      if (!number->is_number()) Expected(Member(place, key), "a number", *number);
      *field = number->get<double>();
    }
  }
  return result;
}

}  // namespace

Scene ParseScene(std::string_view text, std::vector<std::string>& warnings) {
  return Reader().Read(ReadJsonDocument(text, warnings));
}

}  // namespace scene_player
