// What an author would otherwise reach for: the same C chains of M links as
// revolute-joint chains in Box2D, a static anchor, M link bodies and a
// platform body each, stepped at 1/60 s with 8 velocity and 3 position
// iterations. The chains start level (the stored start angle of 90 degrees),
// far enough apart that they never overlap, and no shape collides with any
// other, so the world does the joint work of a swing and little else.
#include <box2d/box2d.h>

#include <benchmark/benchmark.h>

#include "bench_scene.h"

namespace {

constexpr float kMetresPerPixel = 1.0f / 32.0f;

void AddChain(b2World& world, float anchorX, int links) {
  const float linkLength = 8.0f * kMetresPerPixel;
  b2BodyDef anchorDef;
  anchorDef.position.Set(anchorX, 0.0f);
  b2Body* previous = world.CreateBody(&anchorDef);  // static

  b2PolygonShape linkShape;
  linkShape.SetAsBox(linkLength / 2.0f, linkLength / 8.0f);
  b2PolygonShape platformShape;
  platformShape.SetAsBox(2.0f * linkLength, linkLength / 4.0f);
  b2FixtureDef fixture;
  fixture.density = 1.0f;
  fixture.filter.groupIndex = -1;  // never collides

  for (int k = 1; k <= links + 1; ++k) {  // the last body is the platform
    b2BodyDef bodyDef;
    bodyDef.type = b2_dynamicBody;
    bodyDef.position.Set(anchorX - (static_cast<float>(k) - 0.5f) * linkLength, 0.0f);
    b2Body* body = world.CreateBody(&bodyDef);
    fixture.shape = k <= links ? &linkShape : &platformShape;
    body->CreateFixture(&fixture);
    b2RevoluteJointDef joint;
    joint.Initialize(previous, body, b2Vec2(anchorX - (static_cast<float>(k) - 1.0f) * linkLength, 0.0f));
    world.CreateJoint(&joint);
    previous = body;
  }
}

void Box2DChain(benchmark::State& state) {
  const int chains = static_cast<int>(state.range(0));
  const int links = static_cast<int>(state.range(1));
  b2World world(b2Vec2(0.0f, 9.81f));  // y grows downwards, as on the frame
  const float apart = 2.0f * (static_cast<float>(links) + 6.0f) * 8.0f * kMetresPerPixel;
  for (int c = 0; c < chains; ++c) AddChain(world, apart * static_cast<float>(c), links);
  for (auto _ : state) world.Step(1.0f / 60.0f, 8, 3);
  CountChainsAndLinks(state);
}

BENCHMARK(Box2DChain)->Apply(ChainSizes);

}  // namespace
