#pragma once

#include "common/Status.h"
#include "model/UserPort.h"

#include <QString>
#include <QStringList>
#include <cstdio>

namespace zorbin {
struct CatalogSettings;
}

namespace zorbin::bench {

// A user who watches: the progress bar is kept, nothing is asked, nothing stops the run.
class QuietUserPort final : public UserPort
{
public:
    Answer ask(const QString &, const QString &, QuestionButtons) override { return Answer::Yes; }
    void tell(const QString &text, const QString &, MessageIcon) override
    {
        std::fprintf(stderr, "%s\n", qPrintable(text));
    }
    void showStatus(const QString &) override {}
    int progressFrameWidth() const override { return 1000; }
    int progressFillWidth() const override { return m_fill; }
    void setProgressFillWidth(int width) override { m_fill = width; }
    void yield() override {}
    Status openBrowser(const QString &) override { return Status::ok(); }

private:
    int m_fill = 0;
};

// Ends the benchmark with the failure's text: a figure measured past a failure would mislead.
inline void fail(const Status &status)
{
    if (!status)
        qFatal("%s", qPrintable(status.description()));
}

// Writes `count` distinct pictures (PNG and JPEG, of varied sizes, drawn with Qt) into
// `folder`, and a logo; returns their paths, the logo last.
Result<QStringList> makePictures(const QString &folder, int count);

// Creates a working database at `path` with `items` catalog items, item i showing
// pictures[i % pictures.size()], in one transaction.
Status makeWorkDatabase(const QString &path, int items, const QStringList &pictures);

// The catalog settings of the benchmark: 8 rows by 3 columns, a picture line fitted into
// 120 x 90 pixels, four text lines (key, name, price, unit), both bands, the logo.
void useBenchSettings(CatalogSettings &settings, const QString &outputFolder, const QString &logo);

} // namespace zorbin::bench
