#include "card/CardWindow.h"

#include "CardRig.h"
#include "card/MainCard.h"
#include "model/ProgressMeter.h"
#include "model/UserPort.h"
#include "testutil/MemorySettingsStore.h"
#include "testutil/RecordingStages.h"
#include "testutil/TestMain.h"

#include <QPushButton>
#include <QTemporaryDir>
#include <QTest>

using namespace zorbin;
using namespace zorbin::test;

class CardWindowTest : public QObject
{
    Q_OBJECT

private Q_SLOTS:
    void closingDuringARunStopsItAndClosesAfterwards()
    {
        QTemporaryDir output;
        qputenv("ZORBIN_BROWSER", "true");
        RecordingProgram program;
        RecordingStages *stages = program.stages;
        CardWindow window(*program.control, program.user);
        window.card()->control().settings().outputFolder = output.path();
        window.show();
        QVERIFY(QTest::qWaitForWindowExposed(&window));

        bool closedAtOnce = true;
        int rows = 0;
        stages->during = [&](const QString &stage) {
            if (stage != QLatin1String("BuildAndCollectData"))
                return;
            closedAtOnce = window.close();
            RunContext &context = window.card()->control().context();
            ProgressMeter meter(context.user, context.state);
            for (rows = 1; rows <= 100; ++rows) {
                if (meter.tick(rows, 100))
                    break;
            }
        };
        QVERIFY(window.card()->control().makeCatalog().ending != RunOutcome::Ending::Declined);
        QVERIFY(!closedAtOnce);
        QCOMPARE(rows, 5);                                              // the close pressed stop
        QVERIFY(stages->names().contains(QStringLiteral("CreateCSS"))); // the run ended in order
        QTRY_VERIFY(!window.isVisible());
    }

    void closingWhileIdleCloses()
    {
        RecordingProgram program;
        CardWindow window(*program.control, program.user);
        window.show();
        QVERIFY(window.close());
        QVERIFY(!window.isVisible());
    }
};

ZORBIN_TEST_CLASS(CardWindowTest)
#include "CardWindowTest.moc"
