// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <cstddef>

#include "platform/system/WindowsTypes.h"

// Files and drivers of the system hold these structures, so every field has its place.
TEST(WindowsTypes, FieldsLieWhereTheSystemPutsThem) {
  EXPECT_EQ(offsetof(MIDIHDR, dwBufferLength), 8u);
  EXPECT_EQ(offsetof(MIDIHDR, dwUser), 16u);
  EXPECT_EQ(offsetof(MIDIHDR, dwFlags), 24u);
  EXPECT_EQ(offsetof(MIDIHDR, lpNext), 28u);
  EXPECT_EQ(offsetof(MIDIHDR, dwReserved), 48u);
  EXPECT_EQ(offsetof(MIDIOUTCAPSW, szPname), 8u);
  EXPECT_EQ(offsetof(MIDIOUTCAPSW, wTechnology), 72u);
  EXPECT_EQ(offsetof(DMUS_PORTCAPS, dwClass), 24u);
  EXPECT_EQ(offsetof(DMUS_PORTCAPS, wszDescription), 52u);
  EXPECT_EQ(offsetof(DMUS_EVENTHEADER, rtDelta), 8u);
  EXPECT_EQ(offsetof(DMUS_OBJECTDESC, guidClass), 24u);
  EXPECT_EQ(offsetof(DMUS_OBJECTDESC, llMemLength), 832u);
  EXPECT_EQ(offsetof(DMUS_PORTPARAMS8, fShare), 28u);
}

TEST(WindowsTypes, ResultsHaveTheirPublishedNumbers) {
  EXPECT_EQ(static_cast<unsigned>(DMUS_E_BUFFER_EMPTY), 0x88781135u);
  EXPECT_EQ(static_cast<unsigned>(DMUS_E_BUFFER_FULL), 0x88781136u);
  EXPECT_EQ(static_cast<unsigned>(DMUS_E_INVALID_EVENT), 0x8878113Fu);
  EXPECT_EQ(ERROR_TOO_MANY_POSTS, 298u);
  EXPECT_EQ(MIDIERR_STILLPLAYING, 65u);
  EXPECT_EQ(MIM_CLOSE, 962u);
  EXPECT_EQ(MIM_DATA, 963u);
  EXPECT_EQ(MIM_LONGDATA, 964u);
  EXPECT_EQ(MIM_MOREDATA, 972u);
  EXPECT_TRUE(FAILED(E_FAIL));
  EXPECT_FALSE(FAILED(S_FALSE));
}
