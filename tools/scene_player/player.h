// Plays a scene against the library through the stand-in host, as the host
// would: the scene's objects are host objects, its timeline steps run as the
// events of their frame, and its "On Swing" rules run inside the event the
// library raises from each frame's swing step.
#pragma once

#include <cstdint>
#include <exception>
#include <functional>
#include <queue>
#include <set>
#include <string>
#include <unordered_map>
#include <utility>
#include <vector>

#include "host.h"
#include "scene.h"

namespace scene_player {

class Player {
 public:
  // Creates the run-time object from the scene's settings and the objects
  // present at the start. Throws std::runtime_error when the library refuses
  // the object or lacks a routine that the scene uses.
  explicit Player(const Scene& scene);

  // Frame `frame` (frames are played in order from 0): the timeline steps of
  // that frame, then the host's frame, in which the library swings the chains
  // and raises "On Swing". Objects destroyed by then are forgotten when it
  // returns: no pointer to them is kept past the frame in which they went.
  void PlayFrame(int frame);

  const RunData& extension() const { return *extension_; }
  // The host object of scene object `index`, or null while it is not on the
  // frame (not yet created, or destroyed).
  const HostObject* live(std::size_t index) const;
  // The scene object that `object` is, or -1. Between frames the library's
  // lists hold only objects on the frame: it drops the destroyed ones in the
  // frame's step, before the host frees them and before any object can be
  // made at a freed address, so an address found there names one object.
  int IndexOf(const HostObject* object) const;

  // The most chains the library has held at any moment of the run: a chain
  // may come and go within one frame (a rule destroys its anchor).
  uint32_t mostChains() const { return mostChains_; }

  // What the steps run since the last call addressed that did not exist
  // ("PLACE: message"), each step and routine said once in the run.
  std::vector<std::string> TakeWarnings() { return std::exchange(warnings_, {}); }

 private:
  enum class State { NotYet, Live, Destroyed, Gone };
  struct ObjectState {
    State state = State::NotYet;
    HostObject* object = nullptr;
    // The exact position of the last move, so that an object moved by
    // fractions every frame (a rider moved by "DeltaX(") keeps them instead of
    // losing up to a pixel to truncation each time.
    double exactX = 0.0, exactY = 0.0;
  };

  void CheckRoutines() const;
  void Create(std::size_t index);
  void Forget(std::size_t index);
  void RunSteps(const std::vector<Step>& steps);
  void RunStep(const Step& step);
  void RunAction(const Step& step);
  void Move(ObjectState& target, const Step& step);
  double Evaluate(const Value& value);
  void OnEvent(int32_t code);
  HostObject* Live(int index) const;
  // The scene object on the frame that bears the name of object `index`, or -1.
  int Bearer(int index) const;
  void WarnOnce(int code, bool expression, const std::string& missed);

  const Scene& scene_;
  standin::Host host_;
  const RunData* extension_;
  std::vector<ObjectState> objects_;
  std::unordered_map<const HostObject*, int> indexes_;  // of the objects in objects_
  std::vector<int> bearers_;  // by ObjectSpec::firstOfName: the object of that name last created
  std::vector<bool> rulesEnabled_;
  // When each timeline entry runs next: (frame, entry), earliest first, and
  // in the order of the file within a frame.
  std::priority_queue<std::pair<int, std::size_t>, std::vector<std::pair<int, std::size_t>>, std::greater<>> due_;
  int frame_ = 0;       // the frame being played, for {"count": "frame"}
  int repetition_ = 0;  // of the repeating entry being run, for {"count": "repetition"}
  const Step* running_ = nullptr;  // the step being run, for its warnings
  uint32_t mostChains_ = 0;
  std::vector<std::string> warnings_;
  std::set<std::string> warned_;
  // An exception must not cross the library's swing step: one thrown while
  // a rule runs is kept here and rethrown once the frame is over.
  std::exception_ptr eventFailure_;
};

}  // namespace scene_player
