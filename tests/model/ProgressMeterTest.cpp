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
        QTest::newRow("half down to even") << 100 << 5 << 8 << 62;
        QTest::newRow("half up to even") << 100 << 15 << 40 << 38;
        QTest::newRow("all") << 777 << 20 << 20 << 777;
        QTest::newRow("a total of 0 counts as 1") << 100 << 1 << 0 << 100;
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

    // A step yields at every fifth row; the stop button, pressed while it yields, ends the step
    // at that same point.
    void pointsComeEveryFifthRowAndHonourStop()
    {
        RecordingUserPort user;
        RunState state;
        user.onYield = [&] {
            if (user.yields == 3)
                state.StopRequested = true;
        };
        ProgressMeter meter(user, state);
        meter.reset();
        int rows = 0;
        while (rows < 100 && !meter.tick(++rows, 100))
            ;
        QCOMPARE(rows, 15);
        QCOMPARE(user.widths, (QList<int>{0, 50, 100, 150}));
    }
};

ZORBIN_TEST_CLASS(ProgressMeterTest)
#include "ProgressMeterTest.moc"
