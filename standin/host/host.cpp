#include "host.h"

#include <algorithm>
#include <bit>
#include <cstdlib>
#include <cstring>
#include <stdexcept>

#include "frame/exports.h"
#include "routine_call.h"

namespace standin {

namespace {

// A service goes into its slot only with exactly the type the library calls
// it with, calling convention and argument count included.
template <class Service>
HostServiceSlot Slot(Service service) {
  return reinterpret_cast<HostServiceSlot>(service);
}

}  // namespace

Host::Host(const EditData& settings) {
  context_.host = this;
  auto& slots = context_.services.slot;
  slots[kSlotGenerateEvent] = Slot<HostGenerateEventFn>(&GenerateEvent);
  slots[kSlotGetFirstExpressionParameter] = Slot<HostGetExpressionParameterFn>(&GetFirstParameter);
  slots[kSlotGetNextExpressionParameter] = Slot<HostGetExpressionParameterFn>(&GetNextParameter);
  slots[kSlotGetFloatParameter] = Slot<HostGetFloatParameterFn>(&GetFloatParameter);

  GetRunObjectInfos(nullptr, &info_);
  EditData edit = settings;
  const uint16_t size = GetRunObjectDataSize(nullptr, &edit);
  if (size < sizeof(HostObjectHeader)) throw std::runtime_error("run-time object smaller than its header");
  extension_ = static_cast<RunData*>(std::calloc(1, size));
  if (extension_ == nullptr) throw std::bad_alloc();
  extension_->head.context = &context_.services;
  created_ = CreateRunObject(extension_, &edit, nullptr) == 0;
}

Host::~Host() {
  if (created_) DestroyRunObject(extension_, 0);
  std::free(extension_);
  for (HostObject* object : objects_) std::free(object);
}

HostObject* Host::AddObject(int32_t x, int32_t y, int32_t height, ObjectId id) {
  auto* object = static_cast<HostObject*>(std::calloc(1, sizeof(HostObject)));
  if (object == nullptr) throw std::bad_alloc();
  object->head.context = &context_.services;
  object->head.x = x;
  object->head.y = y;
  object->head.height = height;
  object->head.idLow = id.low;
  object->head.idHigh = id.high;
  objects_.push_back(object);
  return object;
}

void Host::Destroy(HostObject* object) {
  if (object->head.flags & kFlagDestroyed) return;
  object->head.flags |= kFlagDestroyed;
  destroyed_.push_back(object);
}

void Host::RunFrame() {
  if (created_) HandleRunObject(extension_);
  FreeDestroyed();
}

void Host::FreeDestroyed() {
  for (HostObject* object : destroyed_) {
    objects_.erase(std::find(objects_.begin(), objects_.end(), object));
    std::free(object);
  }
  destroyed_.clear();
}

int16_t Host::Action(int code, intptr_t param1, intptr_t param2, float floatValue) {
  if (code < 0 || code >= info_.actionCount) throw std::out_of_range("no such action");
  const float saved = floatParameter_;  // actions may run inside another's event
  floatParameter_ = floatValue;
  const int16_t result = CallRoutine(info_.actionRoutines[code], extension_, param1, param2);
  floatParameter_ = saved;
  return result;
}

int16_t Host::ActionWithValue(int code, int32_t index, float value) {
  const double truncated = static_cast<double>(value);
  const intptr_t asInteger =
      (truncated > -2147483649.0 && truncated < 2147483648.0) ? static_cast<int32_t>(truncated) : 0;
  return Action(code, index, asInteger, value);
}

int32_t Host::Condition(int code, intptr_t param1, intptr_t param2) {
  if (code < 0 || code >= info_.conditionCount) throw std::out_of_range("no such condition");
  return CallRoutine(info_.conditionRoutines[code], extension_, param1, param2);
}

int32_t Host::Expression(int code, std::initializer_list<int32_t> params) {
  if (code < 0 || code >= info_.expressionCount) throw std::out_of_range("no such expression");
  const auto savedParameters = parameters_;
  const std::size_t savedNext = nextParameter_;
  parameters_.assign(params.begin(), params.end());
  nextParameter_ = 0;
  extension_->head.flags &= static_cast<uint16_t>(~kFlagFloatResult);
  const int32_t result = CallRoutine(info_.expressionRoutines[code], extension_, reinterpret_cast<intptr_t>(this));
  lastResultWasFloat_ = (extension_->head.flags & kFlagFloatResult) != 0;
  parameters_ = savedParameters;
  nextParameter_ = savedNext;
  return result;
}

float Host::ExpressionFloat(int code, std::initializer_list<int32_t> params) {
  return std::bit_cast<float>(Expression(code, params));
}

Host& Host::From(HostObjectHeader* own) {
  return *reinterpret_cast<Context*>(own->context)->host;
}

void TVCALL Host::GenerateEvent(HostObjectHeader* own, int32_t code, int32_t param) {
  Host& host = From(own);
  ++host.eventsRaised;
  if (host.onEvent) host.onEvent(code, param);
}

int32_t TVCALL Host::GetFirstParameter(HostObjectHeader* own, int32_t, intptr_t) {
  Host& host = From(own);
  ++host.expressionParameterReads;
  host.nextParameter_ = 0;
  return host.nextParameter_ < host.parameters_.size() ? host.parameters_[host.nextParameter_++] : 0;
}

int32_t TVCALL Host::GetNextParameter(HostObjectHeader* own, int32_t, intptr_t) {
  Host& host = From(own);
  ++host.expressionParameterReads;
  return host.nextParameter_ < host.parameters_.size() ? host.parameters_[host.nextParameter_++] : 0;
}

int32_t TVCALL Host::GetFloatParameter(HostObjectHeader* own, int32_t, int32_t) {
  Host& host = From(own);
  ++host.floatParameterCalls;
  return std::bit_cast<int32_t>(host.floatParameter_);
}

}  // namespace standin
