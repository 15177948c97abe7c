#include "frame/OsSwMI.h"

#include "tests/support/FakeCommands.h"
#include "tests/support/FakeFiles.h"

#include <gtest/gtest.h>

namespace os_sw_mi_test
{

class Another : public IC::OsSwMI
{
public:
    ~Another() override
    {
        OsSwMI::unload();
        IC::pOsSwMI = nullptr;
    }
};

TEST(Interface, IsTheCurrentOneOnceItIsInitialised)
{
    FakeFiles const files;
    FakeCommands const commands;
    Another interface;
    interface.initialize(5, IC::Number(0U), IC::Number(0U));
    EXPECT_EQ(IC::pOsSwMI, &interface);
}

} // namespace os_sw_mi_test
