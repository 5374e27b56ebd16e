// The registration tests, against the control library loaded as the host loads it.

#include "ControlModule.h"

#include <QApplication>

#include <gtest/gtest.h>

#include <cstdio>

int main(int argc, char **argv)
{
    QApplication app(argc, argv);
    testing::InitGoogleTest(&argc, argv);
    std::string error;
    if (!Orbane::Test::ControlModule::Load(&error)) {
        std::fprintf(stderr, "cannot load the control library: %s\n", error.c_str());
        return 1;
    }
    return RUN_ALL_TESTS();
}
