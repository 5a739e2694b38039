// Frames run as a game runs them: chains built and started by actions,
// stepped once per frame, and a rule "On Swing" that carries a rider along
// on its platform with "DeltaX(" and "DeltaY(".
#include <algorithm>
#include <cmath>

#include "event_scene.h"

namespace {

class SwingFrameLoopTest : public EventTest {};

TEST_F(SwingFrameLoopTest, RiderMovedByTheDeltasKeepsItsPlaceOnThePlatform) {
  // Two chains of four 16-pixel links, each with its platform; the rider
  // stands on the platform of chain 1.
  AddAnchor(160, 40);
  AddAnchor(480, 40);
  for (int i = 0; i < 8; ++i) AddLink(0, 0, 16);
  AddPlatform(0, 0);
  HostObject* platform = AddPlatform(0, 0);
  host.ActionWithValue(action::SetAngle, 0, -40.0f);
  host.ActionWithValue(action::SetAngle, 1, 55.0f);
  host.Action(action::StartAll);

  // The rider is a float position, as a game keeps a character's.
  float riderX = 0, riderY = 0;
  bool riding = false;
  int rulesRun = 0;
  host.onEvent = [&](int32_t code, int32_t) {
    // Rule: On Swing 1 -> move the rider by the platform's last move.
    if (code != condition::OnSwing || !host.Condition(condition::OnSwing, 1)) return;
    ++rulesRun;
    if (!riding) return;
    riderX += host.ExpressionFloat(expression::DeltaX, {1});
    riderY += host.ExpressionFloat(expression::DeltaY, {1});
  };

  // The first step's delta is measured from the record's initial 0, so the
  // rider boards after it: 12 pixels above where the platform now stands.
  host.RunFrame();
  ASSERT_EQ(rulesRun, 1);
  riderX = static_cast<float>(platform->head.x);
  riderY = static_cast<float>(platform->head.y - 12);
  riding = true;
  const double offsetX = riderX - platform->head.x;
  const double offsetY = riderY - platform->head.y;

  int32_t minX = platform->head.x, maxX = platform->head.x;
  for (int frame = 2; frame <= 600; ++frame) {
    host.RunFrame();
    ASSERT_EQ(rulesRun, frame);
    ASSERT_LE(std::fabs(static_cast<double>(riderX) - platform->head.x - offsetX), 1.0) << "frame " << frame;
    ASSERT_LE(std::fabs(static_cast<double>(riderY) - platform->head.y - offsetY), 1.0) << "frame " << frame;
    // The platform is where "PlatformX(" reports it.
    ASSERT_EQ(host.Expression(expression::PlatformX, {1}), platform->head.x);
    minX = std::min(minX, platform->head.x);
    maxX = std::max(maxX, platform->head.x);
  }
  EXPECT_EQ(host.eventsRaised, 2 * 600);
  EXPECT_GT(maxX - minX, 100) << "the platform should have swung across a wide arc";

  // Stopped, the chain reports no motion: the rider stays where it is.
  host.Action(action::StopChain, 1);
  EXPECT_EQ(host.ExpressionFloat(expression::DeltaX, {1}), 0.0f);
}

}  // namespace
