#include "player.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <cstring>
#include <stdexcept>
#include <string>
#include <utility>

#include "addressing.h"
#include "chains/float_math.h"
#include "event_names.h"

namespace scene_player {

namespace {

constexpr int32_t kOnSwingCondition = 1;

EditData SettingsRecord(const Settings& settings) {
  EditData data{};
  auto copy = [](char (&field)[kSettingTextSize], const std::string& text) {
    std::strncpy(field, text.c_str(), sizeof field - 1);
  };
  copy(data.startAngleText, settings.startAngle);
  copy(data.massText, settings.mass);
  copy(data.gravityText, settings.gravity);
  copy(data.linkSpacingText, settings.linkSpacing);
  return data;
}

int32_t ToInteger(double value) { return TruncateToInt(value, 0); }

void CollectCodes(const Value& value, std::vector<int>& expressions) {
  if (value.expression >= 0) expressions.push_back(value.expression);
  for (const Value& param : value.params) CollectCodes(param, expressions);
}

void CollectCodes(const std::vector<Step>& steps, std::vector<int>& actions, std::vector<int>& expressions) {
  for (const Step& step : steps) {
    if (step.kind == Step::Kind::Action) actions.push_back(step.action);
    for (const Value& value : step.values) CollectCodes(value, expressions);
  }
}

}  // namespace

Player::Player(const Scene& scene) : scene_(scene), host_(SettingsRecord(scene.settings)), extension_(&host_.extension()) {
  if (!host_.created()) throw std::runtime_error("the library refused to create its run-time object");
  CheckRoutines();
  objects_.resize(scene_.objects.size());
  bearers_.assign(scene_.objects.size(), -1);
  for (std::size_t i = 0; i < scene_.objects.size(); ++i) {
    if (scene_.objects[i].atStart) Create(i);
  }
  for (const SwingRule& rule : scene_.rules) rulesEnabled_.push_back(rule.enabled);
  for (std::size_t i = 0; i < scene_.timeline.size(); ++i) due_.emplace(scene_.timeline[i].frame, i);
  host_.onEvent = [this](int32_t code, int32_t) { OnEvent(code); };
}

// A library whose tables lack a routine would crash the first time the scene
// used it; say so before playing anything.
void Player::CheckRoutines() const {
  std::vector<int> actions, expressions;
  for (const TimelineEntry& entry : scene_.timeline) CollectCodes(entry.steps, actions, expressions);
  for (const SwingRule& rule : scene_.rules) CollectCodes(rule.steps, actions, expressions);
  const RunInfo& info = host_.info();
  for (int code : actions) {
    if (code >= info.actionCount || info.actionRoutines[code] == nullptr) {
      throw std::runtime_error(std::string("the library has no routine for the action \"") +
                               kActionNames[code].displayText + "\"");
    }
  }
  for (int code : expressions) {
    if (code >= info.expressionCount || info.expressionRoutines[code] == nullptr) {
      throw std::runtime_error(std::string("the library has no routine for the expression \"") +
                               kExpressionNames[code].displayText + "\"");
    }
  }
  if (!scene_.rules.empty() &&
      (kOnSwingCondition >= info.conditionCount || info.conditionRoutines[kOnSwingCondition] == nullptr)) {
    throw std::runtime_error("the library has no routine for the condition \"On Swing %0\"");
  }
}

void Player::Create(std::size_t index) {
  const ObjectSpec& spec = scene_.objects[index];
  ObjectState& target = objects_[index];
  target.object = host_.AddObject(spec.x, spec.y, spec.height, {spec.idLow, spec.idHigh});
  target.state = State::Live;
  target.exactX = spec.x;
  target.exactY = spec.y;
  indexes_[target.object] = static_cast<int>(index);
  bearers_[static_cast<std::size_t>(spec.firstOfName)] = static_cast<int>(index);
}

void Player::Forget(std::size_t index) {
  indexes_.erase(objects_[index].object);
  objects_[index] = ObjectState{State::Gone};
}

void Player::PlayFrame(int frame) {
  frame_ = frame;
  while (!due_.empty() && due_.top().first <= frame) {
    const auto [at, index] = due_.top();
    due_.pop();
    const TimelineEntry& entry = scene_.timeline[index];
    if (entry.every > 0) {
      repetition_ = (at - entry.frame) / entry.every;
      if (entry.last - at >= entry.every) due_.emplace(at + entry.every, index);
    }
    RunSteps(entry.steps);
  }
  host_.RunFrame();
  // The host frees every object destroyed in this frame, by the timeline or
  // by rules during it, once this frame's handle call has run: each is
  // forgotten now and never touched again.
  for (std::size_t i = 0; i < objects_.size(); ++i) {
    if (objects_[i].state == State::Destroyed) Forget(i);
  }
  if (eventFailure_) std::rethrow_exception(std::exchange(eventFailure_, nullptr));
}

const HostObject* Player::live(std::size_t index) const { return Live(static_cast<int>(index)); }

HostObject* Player::Live(int index) const {
  if (index < 0) return nullptr;
  const ObjectState& target = objects_[static_cast<std::size_t>(index)];
  return target.state == State::Live ? target.object : nullptr;
}

int Player::Bearer(int index) const {
  return bearers_[static_cast<std::size_t>(scene_.objects[static_cast<std::size_t>(index)].firstOfName)];
}

void Player::WarnOnce(int code, bool expression, const std::string& missed) {
  if (missed.empty()) return;
  const std::string key = running_->place + (expression ? " expression " : " action ") + std::to_string(code);
  if (warned_.insert(key).second) warnings_.push_back(running_->place + ": " + missed);
}

int Player::IndexOf(const HostObject* object) const {
  const auto it = indexes_.find(object);
  return it == indexes_.end() ? -1 : it->second;
}

void Player::OnEvent(int32_t code) {
  if (code != kOnSwingCondition || eventFailure_) return;
  try {
    // The host asks the library's own condition which rules apply: "On Swing
    // %0" is true for the chain whose step raised the event.
    for (std::size_t i = 0; i < scene_.rules.size(); ++i) {
      const SwingRule& rule = scene_.rules[i];
      if (rulesEnabled_[i] && host_.Condition(kOnSwingCondition, rule.chain) != 0) RunSteps(rule.steps);
    }
  } catch (...) {
    eventFailure_ = std::current_exception();
  }
}

void Player::RunSteps(const std::vector<Step>& steps) {
  for (const Step& step : steps) RunStep(step);
}

// A step whose object is not on the frame at that moment does nothing, as an
// event of the host does when no instance of its object exists.
void Player::RunStep(const Step& step) {
  running_ = &step;
  switch (step.kind) {
    case Step::Kind::Action:
      // Only actions add chains.
      RunAction(step);
      mostChains_ = std::max(mostChains_, ChainCount(*extension_));
      return;
    case Step::Kind::Create:
      Create(static_cast<std::size_t>(step.object));
      return;
    case Step::Kind::Destroy:
      if (const int bearer = Bearer(step.object); HostObject* object = Live(bearer)) {
        host_.Destroy(object);
        objects_[static_cast<std::size_t>(bearer)].state = State::Destroyed;
      }
      return;
    case Step::Kind::MoveTo:
    case Step::Kind::MoveBy:
      if (const int bearer = Bearer(step.object); Live(bearer)) Move(objects_[static_cast<std::size_t>(bearer)], step);
      return;
    case Step::Kind::Enable:
    case Step::Kind::Disable:
      rulesEnabled_[static_cast<std::size_t>(step.rule)] = step.kind == Step::Kind::Enable;
      return;
  }
}

void Player::RunAction(const Step& step) {
  const ActionName& action = kActionNames[step.action];
  if (action.paramCount > 0 && action.kinds[0] == ParamKind::Object) {
    HostObject* object = Live(Bearer(step.object));
    if (object != nullptr) host_.Action(step.action, reinterpret_cast<intptr_t>(object));
    return;
  }
  // The host evaluates the parameters in order before it calls the routine.
  const int32_t first = step.values.empty() ? 0 : ToInteger(Evaluate(step.values[0]));
  const double second = step.values.size() > 1 ? Evaluate(step.values[1]) : 0.0;
  WarnOnce(step.action, false, MissedByAction(*extension_, step.action, first));
  if (action.paramCount == 2 && action.kinds[1] == ParamKind::Float) {
    host_.ActionWithValue(step.action, first, RoundToFloat(second));
  } else {
    host_.Action(step.action, first, ToInteger(second), RoundToFloat(second));
  }
}

void Player::Move(ObjectState& target, const Step& step) {
  const double x = Evaluate(step.values[0]);
  const double y = Evaluate(step.values[1]);
  HostObjectHeader& head = target.object->head;
  auto place = [&](int32_t& coordinate, double& exact, double value) {
    // Someone else (the library) moved it since: start from where it is.
    if (TruncateToInt(exact, coordinate) != coordinate) exact = coordinate;
    const double next = step.kind == Step::Kind::MoveTo ? value : exact + value;
    if (!std::isfinite(next)) return;
    exact = next;
    coordinate = TruncateToInt(next, coordinate);
  };
  place(head.x, target.exactX, x);
  place(head.y, target.exactY, y);
  target.object->changed = 1;
}

double Player::Evaluate(const Value& value) {
  switch (value.count) {
    case Value::Count::Frame: return value.plus + value.times * frame_;
    case Value::Count::Repetition: return value.plus + value.times * repetition_;
    case Value::Count::None: break;
  }
  if (value.expression < 0) return value.number;
  int32_t params[2] = {0, 0};
  for (std::size_t i = 0; i < value.params.size() && i < 2; ++i) params[i] = ToInteger(Evaluate(value.params[i]));
  WarnOnce(value.expression, true, MissedByExpression(*extension_, value.expression, params));
  int32_t result = 0;
  switch (value.params.size()) {
    case 0: result = host_.Expression(value.expression); break;
    case 1: result = host_.Expression(value.expression, {params[0]}); break;
    default: result = host_.Expression(value.expression, {params[0], params[1]}); break;
  }
  return host_.lastResultWasFloat() ? static_cast<double>(std::bit_cast<float>(result)) : static_cast<double>(result);
}

}  // namespace scene_player
