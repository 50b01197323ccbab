#include "model/ProgressMeter.h"

#include "model/RunState.h"
#include "testutil/RecordingUserPort.h"
#include "testutil/TestMain.h"

#include <QTest>

using namespace zorbin;
using zorbin::test::RecordingUserPort;

class ProgressMeterTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void widthIsTheShareOfTheFrame_data()
    {
        QTest::addColumn<int>("frame");
        QTest::addColumn<int>("done");
        QTest::addColumn<int>("total");
        QTest::addColumn<int>("width");
        QTest::newRow("5 of 12") << 1000 << 5 << 12 << 417;
        QTest::newRow("10 of 12") << 1000 << 10 << 12 << 833;
        QTest::newRow("half down to even") << 100 << 5 << 8 << 62;
        QTest::newRow("half up to even") << 100 << 15 << 40 << 38;
        QTest::newRow("all") << 777 << 20 << 20 << 777;
        QTest::newRow("a total of 0 counts as 1") << 100 << 0 << 0 << 0;
    }
    void widthIsTheShareOfTheFrame()
    {
        QFETCH(int, frame);
        QFETCH(int, done);
        QFETCH(int, total);
        QFETCH(int, width);
        RecordingUserPort user;
        user.frameWidth = frame;
        RunState state;
        ProgressMeter(user, state).point(done, total);
        QCOMPARE(user.fillWidth, width);
        QCOMPARE(user.yields, 1);
    }

    void pointsComeEveryFifthRow()
    {
        RecordingUserPort user;
        RunState state;
        ProgressMeter meter(user, state);
        meter.reset();
        for (int row = 1; row <= 12; ++row)
            QVERIFY(!meter.tick(row, 12));
        QCOMPARE(user.yields, 2);
        QCOMPARE(user.widths, (QList<int>{0, 417, 833}));
    }

    // The stop button is pressed while the step yields: the step learns it at that same point.
    void stopPressedDuringAYieldEndsTheStep()
    {
        RecordingUserPort user;
        RunState state;
        user.onYield = [&] {
            if (user.yields == 2)
                state.StopRequested = true;
        };
        ProgressMeter meter(user, state);
        int rows = 0;
        for (int row = 1; row <= 100; ++row) {
            ++rows;
            if (meter.tick(row, 100))
                break;
        }
        QCOMPARE(rows, 10);
    }
};

ZORBIN_TEST_CLASS(ProgressMeterTest)
#include "ProgressMeterTest.moc"
