// Records shared with the host keep their byte layout; the sizes and offsets
// are asserted at compile time in the headers, these check what the host
// sees at run time.
#include <cstring>

#include <gtest/gtest.h>

#include "chains/run_data.h"
#include "frame/exports.h"
#include "frame/host_object.h"
#include "frame/run_info.h"

namespace {

TEST(Layout, IdentifierBytesHoldTheCharactersLastToFirst) {
  RunInfo info{};
  GetRunObjectInfos(nullptr, &info);
  char bytes[4];
  std::memcpy(bytes, &info.identifier, 4);
  EXPECT_EQ(std::string(bytes, 4), "NRVT");
}

TEST(Layout, RunDataSizeIsWhatTheHostAllocates) {
  EXPECT_EQ(GetRunObjectDataSize(nullptr, nullptr), sizeof(RunData));
  EXPECT_EQ(sizeof(RunData), sizeof(void*) == 8 ? 232u : 216u);
}

TEST(Layout, ObjectIdentifierSignExtendsTheLowHalf) {
  HostObjectHeader object{};
  object.idHigh = 1;
  object.idLow = -1;
  EXPECT_EQ(ObjectIdentifier(object), 65535);
  object.idHigh = 0;
  EXPECT_EQ(ObjectIdentifier(object), -1);
  object.idHigh = 0xFFFF;
  object.idLow = -32768;
  EXPECT_EQ(ObjectIdentifier(object), static_cast<int32_t>(0xFFFF0000u - 32768u));
  object.idHigh = 2;
  object.idLow = 5;
  EXPECT_EQ(ObjectIdentifier(object), 0x20005);
}

}  // namespace
