// A small real host for the library off Windows: it owns object records laid
// out as the host lays them out, gives the extension its run-time services,
// and drives the library through its entry points and routine tables as the
// host does. Tests, tools and benchmarks run the library through it.
#pragma once

#include <cstdint>
#include <functional>
#include <initializer_list>
#include <vector>

#include "chains/run_data.h"
#include "frame/edit_data.h"
#include "frame/host_services.h"
#include "frame/run_info.h"

namespace standin {

// An object identifier split the way the host stores it.
struct ObjectId {
  int16_t low = 0;
  uint16_t high = 0;
};

class Host {
 public:
  // Asks the library for its RunInfo and data size, allocates the run-time
  // object and creates it from `settings`.
  explicit Host(const EditData& settings);
  ~Host();
  Host(const Host&) = delete;
  Host& operator=(const Host&) = delete;

  // False when the library refused the creation (CreateRunObject gave -1).
  bool created() const { return created_; }
  RunData& extension() { return *extension_; }
  const RunInfo& info() const { return info_; }

  // A new object of the frame, zero-filled but for what is given.
  HostObject* AddObject(int32_t x, int32_t y, int32_t height, ObjectId id = {});
  // Marks the object as being destroyed. It stays readable and writable
  // until HandleRunObject has returned in this frame (the next RunFrame, or
  // the running one when destroyed during its events), and not a moment
  // longer: it is then freed, as the host frees it.
  void Destroy(HostObject* object);

  // One frame: HandleRunObject, then every object destroyed so far is freed.
  void RunFrame();

  // Runs an action through the action table. `floatValue` is what the
  // float-parameter service answers while the action runs.
  int16_t Action(int code, intptr_t param1 = 0, intptr_t param2 = 0, float floatValue = 0.0f);
  // An action whose second parameter is a number: passed as its integer
  // value and, through the float-parameter service, as a float.
  int16_t ActionWithValue(int code, int32_t index, float value);
  int32_t Condition(int code, intptr_t param1, intptr_t param2 = 0);
  // Runs an expression with the given parameters; the raw 32-bit result.
  int32_t Expression(int code, std::initializer_list<int32_t> params = {});
  float ExpressionFloat(int code, std::initializer_list<int32_t> params = {});
  // Whether the last expression set the float-result flag.
  bool lastResultWasFloat() const { return lastResultWasFloat_; }

  // Called for every event the extension raises, before HostGenerateEvent
  // returns; it may run actions, conditions and expressions.
  std::function<void(int32_t code, int32_t param)> onEvent;

  // Counters of service calls, for tests of what the library asks.
  int floatParameterCalls = 0;
  int expressionParameterReads = 0;
  int eventsRaised = 0;

 private:
  static void TVCALL GenerateEvent(HostObjectHeader* own, int32_t code, int32_t param);
  static int32_t TVCALL GetFirstParameter(HostObjectHeader* own, int32_t zero, intptr_t token);
  static int32_t TVCALL GetNextParameter(HostObjectHeader* own, int32_t zero, intptr_t token);
  static int32_t TVCALL GetFloatParameter(HostObjectHeader* own, int32_t one, int32_t zero);
  static Host& From(HostObjectHeader* own);
  void FreeDestroyed();

  struct Context {
    HostRunContext services;  // first: the extension sees only the slots
    Host* host;
  };

  Context context_{};
  RunInfo info_{};
  RunData* extension_ = nullptr;
  bool created_ = false;
  std::vector<HostObject*> objects_;
  std::vector<HostObject*> destroyed_;
  float floatParameter_ = 0.0f;
  std::vector<int32_t> parameters_;
  std::size_t nextParameter_ = 0;
  bool lastResultWasFloat_ = false;
};

}  // namespace standin
