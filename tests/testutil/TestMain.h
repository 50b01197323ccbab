#pragma once

#include <QTest>

// A test program of several QtTest classes: each class's file ends in ZORBIN_TEST_CLASS(Class),
// and the program's main() declares ZORBIN_DECLARE_TEST(Class) and adds up run<Class>(argc, argv),
// the number of classes that failed.
#define ZORBIN_TEST_CLASS(Class)                                                                             \
    int run##Class(int argc, char *argv[])                                                                   \
    {                                                                                                        \
        Class test;                                                                                          \
        return QTest::qExec(&test, argc, argv) != 0 ? 1 : 0;                                                 \
    }
#define ZORBIN_DECLARE_TEST(Class) int run##Class(int argc, char *argv[]);
