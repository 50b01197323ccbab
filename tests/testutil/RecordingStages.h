#pragma once

#include "control/CatalogStages.h"
#include "model/RunContext.h"

#include <QRegularExpression>
#include <QStringList>
#include <functional>

namespace zorbin::test {

// Stages that record each call with its arguments ("CreateCSS(/out/,true)") and return what the
// test set. `during` runs inside a named stage, where a test can press stop or start a second run.
class RecordingStages final : public CatalogStages
{
public:
    void GetRegConnParams(RunContext &context) override { record(context, u"GetRegConnParams()"); }
    void FillCmbExtraNote(RunContext &context) override { record(context, u"FillCmbExtraNote()"); }
    void FillCmbPriceField(RunContext &context) override { record(context, u"FillCmbPriceField()"); }
    Result<CollectionReport> BuildAndCollectData(RunContext &context) override
    {
        context.state.WorkDBFile = workDBFile;
        record(context, QStringLiteral("BuildAndCollectData()"));
        if (!collectResult)
            return collectResult;
        return CollectionReport{stepFailure, context.state.StopRequested};
    }
    Status CollectCatImages(RunContext &context, const QString &imagesFolder, const QString &dbFile) override
    {
        record(context, QStringLiteral("CollectCatImages(%1,%2)").arg(imagesFolder, dbFile));
        return imagesResult;
    }
    Result<QString> CreateCatHTML(RunContext &context, const QString &pagePrefix, const QString &dbFile,
                                  const QString &imagesFolder) override
    {
        record(context, QStringLiteral("CreateCatHTML(%1,%2,%3)").arg(pagePrefix, dbFile, imagesFolder));
        if (!pagesResult)
            return pagesResult;
        return firstPage;
    }
    Status CreateCSS(RunContext &context, const QString &outputFolder, bool replace) override
    {
        record(context, QStringLiteral("CreateCSS(%1,%2)")
                            .arg(outputFolder, replace ? QStringLiteral("true") : QStringLiteral("false")));
        return cssResult;
    }
    Status CreateListHTML(RunContext &context, const QString &fileName, const QString &dbFile) override
    {
        record(context, QStringLiteral("CreateListHTML(%1,%2)").arg(fileName, dbFile));
        return listResult;
    }

    Result<PdfWritten> CreateCatPDF(RunContext &context, const PdfRequest &request) override
    {
        record(context, QStringLiteral("CreateCatPDF(%1,%2)").arg(request.file, request.dbFile));
        return PdfWritten{PdfWritten::Ending::Written, request.file, 1, 0, 0};
    }
    Result<QString> CreateCatSite(RunContext &context, const SiteRequest &request) override
    {
        record(context, QStringLiteral("CreateCatSite(%1,%2,%3)")
                            .arg(request.folder, request.dbFile)
                            .arg(request.sections));
        return request.folder + QStringLiteral("/index.html");
    }

    // The calls without their arguments, e.g. "CreateCSS".
    QStringList names() const
    {
        QStringList result = calls;
        return result.replaceInStrings(QRegularExpression(QStringLiteral("\\(.*")), QString());
    }

    QStringList calls;
    QString workDBFile = QStringLiteral("/tmp/zorbindb.tmp");
    QString firstPage = QStringLiteral("/out/zoindex.htm");
    Status collectResult; // a failure the collection cannot start with
    Status stepFailure;   // a failed step of a collection that started
    Status imagesResult;
    Status pagesResult;
    Status cssResult;
    Status listResult;
    // Stage name (e.g. "BuildAndCollectData") -> what happens inside it.
    std::function<void(const QString &stage)> during;
    // What a stop request looked like when each stage began.
    QList<bool> stopSeen;

private:
    void record(const RunContext &context, QStringView call)
    {
        calls << call.toString();
        stopSeen << context.state.StopRequested;
        if (during)
            during(call.left(call.indexOf(u'(')).toString());
    }
};

} // namespace zorbin::test
