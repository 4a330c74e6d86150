#include "platform/Application.h"

#include <QByteArray>
#include <gtest/gtest.h>

int main(int argc, char** argv)
{
    testing::InitGoogleTest(&argc, argv);
    // Without a screen, but with room for one, unless a platform is asked for.
    if (!qEnvironmentVariableIsSet("QT_QPA_PLATFORM"))
        qputenv("QT_QPA_PLATFORM", QByteArray("offscreen:configfile=" PELORIN_SCREEN));
    BApplication application("application/x-vnd.Pelorin");
    return RUN_ALL_TESTS();
}
