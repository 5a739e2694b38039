// Runs an arbitrary event program against one run-time object created from
// any stored settings (it is always made), through the stand-in host: objects created and
// destroyed, any action with any index and value (infinities and NaN
// included), conditions, expressions and frames, with further actions run
// from inside "On Swing". Nothing may crash, read freed memory or convert a
// value it cannot represent; an object the program never handed over is
// never written; an expression flags a float result exactly when it gives
// one; after a frame the lists hold only live objects.
#include <algorithm>
#include <bit>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <vector>

#include "chains/run_data.h"
#include "frame/edit_data.h"
#include "fuzz_input.h"
#include "host.h"

namespace {

class Run {
 public:
  Run(const uint8_t* data, size_t size) : program_(data, size), host_(Settings(program_)) {
    Check(host_.created());  // whatever the settings hold
    host_.onEvent = [this](int32_t, int32_t) {
      // An "On Swing" rule of up to three actions, conditions or expressions.
      for (int i = 0; i < 3 && !program_.done() && depth_ < 2; ++i) {
        ++depth_;
        Step(false);
        --depth_;
      }
    };
  }

  void Play() {
    const HostObject before = *bystander_;
    while (!program_.done()) Step(true);
    Check(std::memcmp(&before, bystander_, sizeof before) == 0);
  }

 private:
  // Any 100 bytes, as a damaged or hand-edited stored game may hold.
  static EditData Settings(FuzzInput& program) {
    uint8_t bytes[sizeof(EditData)];
    for (uint8_t& byte : bytes) byte = program.Byte();
    EditData edit;
    std::memcpy(&edit, bytes, sizeof edit);
    return edit;
  }

  // After a frame every list element is an object the program still has.
  void CheckListsHoldLiveObjects() {
    RunData& rd = host_.extension();
    const auto live = [this](const HostObject* object) {
      return std::find(objects_.begin(), objects_.end(), object) != objects_.end();
    };
    for (uint32_t i = 0; i < PlatformCount(rd); ++i) Check(live(rd.platforms->At(i)));
    for (uint32_t i = 0; i < LinkCount(rd); ++i) Check(live(rd.links->At(i)));
    for (uint32_t i = 0; i < ChainCount(rd); ++i) Check(live(rd.chains->At(i).anchor));
  }

  // Every byte of the chains, of their anchors and of the listed objects.
  std::vector<uint8_t> Snapshot() {
    RunData& rd = host_.extension();
    std::vector<uint8_t> bytes;
    const auto add = [&bytes](const void* at, size_t size) {
      bytes.insert(bytes.end(), static_cast<const uint8_t*>(at), static_cast<const uint8_t*>(at) + size);
    };
    for (uint32_t i = 0; i < ChainCount(rd); ++i) {
      add(&rd.chains->At(i), sizeof(ChainRecord));
      add(rd.chains->At(i).anchor, sizeof(HostObject));
    }
    for (uint32_t i = 0; i < LinkCount(rd); ++i) add(rd.links->At(i), sizeof(HostObject));
    for (uint32_t i = 0; i < PlatformCount(rd); ++i) add(rd.platforms->At(i), sizeof(HostObject));
    return bytes;
  }

  // The host frees the objects destroyed so far once the frame has run.
  void RunFrame() {
    host_.RunFrame();
    dying_.clear();
    if (host_.created()) CheckListsHoldLiveObjects();
  }

  // A live object, or one destroyed in this frame: the host may still hand
  // that to an action until the frame's handle call has run.
  intptr_t ObjectArgument() {
    const size_t count = objects_.size() + dying_.size();
    if (count == 0) return 0;
    const size_t which = program_.Byte() % count;
    return reinterpret_cast<intptr_t>(which < objects_.size() ? objects_[which] : dying_[which - objects_.size()]);
  }

  void Step(bool mayRunFrame) {
    switch (program_.Byte() % 7) {
      case 0: {
        const int32_t x = program_.Int(), y = program_.Int(), height = program_.Int();
        const standin::ObjectId id{static_cast<int16_t>(program_.Byte()), program_.Byte()};
        objects_.push_back(host_.AddObject(x, y, height, id));
        break;
      }
      case 1: {
        const int code = program_.Byte() % 16;
        if (code <= 2) {
          host_.Action(code, ObjectArgument());
        } else {
          const int32_t index = program_.Near(1, 8);
          const int32_t integer = program_.Int();
          const float value = std::bit_cast<float>(program_.Int());
          // An index that addresses no chain changes nothing (but for the
          // actions on all chains); a float setter reads its value, once.
          const bool addressed = static_cast<uint32_t>(index) < ChainCount(host_.extension());
          const std::vector<uint8_t> before = Snapshot();
          const int floatReads = host_.floatParameterCalls;
          host_.Action(code, index, integer, value);
          constexpr uint32_t kOnAllChains = 1u << 9 | 1u << 11 | 1u << 13;
          constexpr uint32_t kFloatSetters = 1u << 5 | 1u << 6 | 1u << 7 | 1u << 8 | 1u << 15;
          Check(addressed || ((kOnAllChains >> code) & 1u) || Snapshot() == before);
          Check(host_.floatParameterCalls == floatReads + static_cast<int>((kFloatSetters >> code) & 1u));
        }
        break;
      }
      case 2: {
        const int code = program_.Byte() % 2;
        const int32_t index = program_.Near(1, 8);
        // "Chain is swinging" only of a chain there is, "On Swing" never of a negative index.
        const bool possible = code == 0 ? static_cast<uint32_t>(index) < ChainCount(host_.extension()) : index >= 0;
        Check(host_.Condition(code, index) == 0 || possible);
        break;
      }
      case 3: {
        const int code = program_.Byte() % 17;
        const int32_t first = program_.Near(1, 8);
        host_.Expression(code, {first, program_.Near(1, 8)});
        // Mass, angle, speed, spacing, the deltas and the acceleration are
        // floats; counts, coordinates and indexes are integers.
        constexpr uint32_t kFloatCodes = 1u << 4 | 1u << 5 | 1u << 6 | 1u << 7 | 1u << 11 | 1u << 12 | 1u << 13;
        Check(host_.lastResultWasFloat() == ((kFloatCodes >> code) & 1u));
        break;
      }
      case 4:
        if (mayRunFrame) RunFrame();
        break;
      case 5:
        if (!objects_.empty()) {
          const size_t which = program_.Byte() % objects_.size();
          host_.Destroy(objects_[which]);
          dying_.push_back(objects_[which]);
          objects_.erase(objects_.begin() + static_cast<std::ptrdiff_t>(which));
        }
        break;
      default:
        for (int frames = program_.Byte() % 8; frames > 0 && mayRunFrame; --frames) RunFrame();
        break;
    }
  }

  FuzzInput program_;
  standin::Host host_;
  // An object of the frame that no action is ever given.
  HostObject* bystander_ = host_.AddObject(7, 7, 7, {7, 7});
  std::vector<HostObject*> objects_;
  std::vector<HostObject*> dying_;  // destroyed in this frame, freed after it
  int depth_ = 0;
};

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
  Run(data, size).Play();
  return 0;
}
