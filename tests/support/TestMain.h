#pragma once

#include <QtTest>
#include <functional>

// Registers a test class with the folder's test executable.
bool RegisterTestClass(std::function<int(int, char**)> run);

#define VENNICK_TEST(Class)                                                              \
    static const bool vennickRegistered##Class = RegisterTestClass([](int argc, char** argv) { \
        Class test;                                                                      \
        return QTest::qExec(&test, argc, argv);                                          \
    })
