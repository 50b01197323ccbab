#pragma once

#include "control/CatalogStages.h"
#include "model/RunContext.h"

#include <QStringList>
#include <functional>

namespace zorbin::test {

// Stages that record each call with its arguments ("CreateCSS(/out/,true)") and return what the
// test set. `during` runs inside a named stage, where a test can press stop or start a second run.
class RecordingStages final : public CatalogStages
{
public:
    explicit RecordingStages(RunContext &context) : m_context(context) {}

    void GetRegConnParams() override { record(QStringLiteral("GetRegConnParams()")); }
    void FillCmbExtraNote() override { record(QStringLiteral("FillCmbExtraNote()")); }
    void FillCmbPriceField() override { record(QStringLiteral("FillCmbPriceField()")); }
    Status BuildAndCollectData() override
    {
        m_context.state.WorkDBFile = workDBFile;
        record(QStringLiteral("BuildAndCollectData()"));
        return collectResult;
    }
    Status CollectCatImages(const QString &imagesFolder, const QString &dbFile) override
    {
        record(QStringLiteral("CollectCatImages(%1,%2)").arg(imagesFolder, dbFile));
        return imagesResult;
    }
    Result<QString> CreateCatHTML(const QString &pagePrefix, const QString &dbFile,
                                  const QString &imagesFolder) override
    {
        record(QStringLiteral("CreateCatHTML(%1,%2,%3)").arg(pagePrefix, dbFile, imagesFolder));
        if (!pagesResult)
            return pagesResult;
        return firstPage;
    }
    Status CreateCSS(const QString &outputFolder, bool replace) override
    {
        record(QStringLiteral("CreateCSS(%1,%2)")
                   .arg(outputFolder, replace ? QStringLiteral("true") : QStringLiteral("false")));
        return cssResult;
    }
    Status CreateListHTML(const QString &fileName, const QString &dbFile) override
    {
        record(QStringLiteral("CreateListHTML(%1,%2)").arg(fileName, dbFile));
        return listResult;
    }

    // The calls without their arguments, e.g. "CreateCSS".
    QStringList names() const
    {
        QStringList result;
        for (const QString &call : calls)
            result << call.left(call.indexOf(QLatin1Char('(')));
        return result;
    }

    QStringList calls;
    QString workDBFile = QStringLiteral("/tmp/zorbindb.tmp");
    QString firstPage = QStringLiteral("/out/zoindex.htm");
    Status collectResult;
    Status imagesResult;
    Status pagesResult;
    Status cssResult;
    Status listResult;
    // Stage name (e.g. "BuildAndCollectData") -> what happens inside it.
    std::function<void(const QString &stage)> during;
    // What a stop request looked like when each stage began.
    QList<bool> stopSeen;

private:
    void record(const QString &call)
    {
        calls << call;
        stopSeen << m_context.state.StopRequested;
        if (during)
            during(call.left(call.indexOf(QLatin1Char('('))));
    }

    RunContext &m_context;
};

} // namespace zorbin::test
