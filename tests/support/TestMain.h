#pragma once

#include <QtTest>
#include <chrono>
#include <functional>

// Registers a test class with the folder's test executable. Functions named on
// the command line run in the classes that have them; the others stay silent.
bool RegisterTestClass(const QMetaObject& meta, std::function<int(int, char**)> run);

// Qt Test ends the run when a test function takes longer than its limit, five
// minutes unless QTEST_FUNCTION_TIMEOUT says otherwise. A class that needs more
// asks here, before main runs, as registration does; the longest wish holds for
// the whole executable, and a limit set in the environment is kept.
bool AllowFunctionTime(std::chrono::milliseconds limit);

#define VENNICK_TEST(Class)                                                                  \
    static const bool vennickRegistered##Class =                                             \
        RegisterTestClass(Class::staticMetaObject, [](int argc, char** argv) {               \
            Class test;                                                                      \
            return QTest::qExec(&test, argc, argv);                                          \
        })
