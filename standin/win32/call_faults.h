// A countdown that makes a stand-in call fail on demand, as it would when
// the system runs out of memory.
#pragma once

namespace standin {

class CallFaults {
 public:
  void Arm(int successes, int failures) {
    successes_ = successes < 0 ? 0 : successes;
    failures_ = failures < 0 ? 0 : failures;
  }
  // True when this call is to fail.
  bool NextCallFails() {
    if (failures_ == 0) return false;
    if (successes_ > 0) {
      --successes_;
      return false;
    }
    --failures_;
    return true;
  }

 private:
  int successes_ = 0;
  int failures_ = 0;
};

}  // namespace standin
