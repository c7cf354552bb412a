// SPDX-License-Identifier: MIT
#include "api/Link.h"

namespace Ostinet::Testing {

unsigned char gAddress[4 * sizeof(void*)];

}  // namespace Ostinet::Testing
