// libmihostcheck in hosts that are right, and in hosts that are wrong in one way each.

#include "tests/support/Lines.h"
#include "tests/support/Program.h"
#include "tests/support/ScratchFolder.h"

#include <cstdlib>
#include <gtest/gtest.h>

namespace
{
TEST(A, B) {}
} // namespace
