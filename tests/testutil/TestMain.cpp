#include "testutil/TestMain.h"

#include <QTest>

namespace zorbin::test {

int runTestObjects(int argc, char *argv[], const std::vector<std::unique_ptr<QObject>> &tests)
{
    int failed = 0;
    for (const auto &test : tests)
        failed += QTest::qExec(test.get(), argc, argv) != 0 ? 1 : 0;
    return failed;
}

} // namespace zorbin::test
