#pragma once

#include "workdb/SqliteEngine.h"

#include <QObject>
#include <QTest>
#include <memory>
#include <vector>

// One test executable per module, holding several QtTest classes:
//
//   FooTest.cpp:  class FooTest : public QObject { Q_OBJECT ... };  ZORBIN_TEST_CLASS(FooTest)  #include
//   "FooTest.moc" main.cpp:     ZORBIN_DECLARE_TEST(FooTest)
//                 ZORBIN_TEST_MAIN_BEGIN(QCoreApplication)   // QApplication for widget tests
//                 ZORBIN_TEST_ADD(FooTest)
//                 ZORBIN_TEST_MAIN_END
namespace zorbin::test {

// Runs each test object with the command-line arguments; the number of classes that failed.
inline int runTestObjects(int argc, char *argv[], const std::vector<std::unique_ptr<QObject>> &tests)
{
    int failed = 0;
    for (const auto &test : tests)
        failed += QTest::qExec(test.get(), argc, argv) != 0 ? 1 : 0;
    return failed;
}

} // namespace zorbin::test

#define ZORBIN_TEST_CLASS(Class)                                                                             \
    std::unique_ptr<QObject> make##Class()                                                                   \
    {                                                                                                        \
        return std::make_unique<Class>();                                                                    \
    }

#define ZORBIN_DECLARE_TEST(Class) std::unique_ptr<QObject> make##Class();

#define ZORBIN_TEST_MAIN_BEGIN(AppType)                                                                      \
    int main(int argc, char *argv[])                                                                         \
    {                                                                                                        \
        zorbin::setUpSqliteEngine(); /* as the programs do */                                                \
        AppType app(argc, argv);                                                                             \
        std::vector<std::unique_ptr<QObject>> tests;
#define ZORBIN_TEST_ADD(Class) tests.push_back(make##Class());
#define ZORBIN_TEST_MAIN_END                                                                                 \
    return zorbin::test::runTestObjects(argc, argv, tests);                                                  \
    }
