#pragma once

#include "card/FileChooser.h"
#include "card/MainCard.h"
#include "card/WidgetUserPort.h"
#include "control/Program.h"
#include "platform/FileSystem.h"
#include "testutil/MemorySettingsStore.h"
#include "testutil/RecordingStages.h"

#include <QAbstractButton>
#include <QApplication>
#include <QDialog>
#include <QMessageBox>
#include <QTemporaryDir>
#include <QTest>
#include <QTimer>
#include <functional>
#include <memory>
#include <optional>

namespace zorbin::test {

// Answers the modal message boxes and dialogs that a test's clicks open: message boxes with the
// queued buttons (OK, or No to a question, when the queue is empty), dialogs through `onDialog`
// (which must close them; they are rejected otherwise). Records every message box's text.
class ModalAnswerer : public QObject
{
public:
    ModalAnswerer()
    {
        m_timer.setInterval(20);
        QObject::connect(&m_timer, &QTimer::timeout, this, [this] { answer(); });
        m_timer.start();
    }

    QList<QMessageBox::StandardButton> buttons;
    QStringList texts;
    QStringList titles;
    QList<QMessageBox::Icon> icons;
    std::function<void(QDialog *)> onDialog;

private:
    void answer()
    {
        QWidget *modal = QApplication::activeModalWidget();
        if (auto *box = qobject_cast<QMessageBox *>(modal)) {
            texts << box->text();
            titles << box->windowTitle();
            icons << box->icon();
            QMessageBox::StandardButton pressed = QMessageBox::Ok;
            if (!buttons.isEmpty())
                pressed = buttons.takeFirst();
            else if (box->standardButtons() & QMessageBox::No)
                pressed = QMessageBox::No;
            QAbstractButton *button = box->button(pressed);
            if (button)
                button->click();
            else
                box->reject();
        } else if (auto *dialog = qobject_cast<QDialog *>(modal)) {
            if (onDialog)
                onDialog(dialog);
            if (dialog->isVisible())
                dialog->reject();
        }
    }

    QTimer m_timer;
};

// Answers the file dialogs of the settings page: records each request and returns the queued
// answer (nothing stands for Cancel).
class FakeFileChooser final : public FileChooser
{
public:
    std::optional<QString> openFile(QWidget *, const FileRequest &request) override
    {
        fileRequests << request;
        return answer;
    }
    std::optional<QString> chooseFolder(QWidget *, const QString &title, const QString &startFolder) override
    {
        folderTitles << title;
        folderStarts << startFolder;
        return answer;
    }

    std::optional<QString> answer;
    QList<FileRequest> fileRequests;
    QStringList folderTitles;
    QStringList folderStarts;
};

// The desktop program's parts over an in-memory store and recording stages, as the program
// assembles them: the port, the control, and then the window that shows them.
struct RecordingProgram
{
    RecordingProgram()
    {
        auto made = std::make_unique<RecordingStages>();
        stages = made.get();
        control = std::make_unique<CatalogControl>(user, store, localFileSystem(), std::move(made));
    }

    MemorySettingsStore store;
    WidgetUserPort user;
    RecordingStages *stages = nullptr;
    std::unique_ptr<CatalogControl> control;
};

// The desktop program's parts as the program itself assembles them, over a given store.
struct AssembledProgram
{
    explicit AssembledProgram(SettingsStore &store) : control(assembleControl(user, store)) {}

    WidgetUserPort user;
    std::unique_ptr<CatalogControl> control;
};

// A settings card over a recording program. `fillLists` runs inside the start-up's list
// filling, as the accounting database would fill the lists.
struct CardRig
{
    void start()
    {
        stages->during = [this](const QString &stage) {
            if (stage == QLatin1String("FillCmbPriceField") && fillLists)
                fillLists(program.control->settings());
            if (during)
                during(stage);
        };
        card = std::make_unique<MainCard>(*program.control, program.user);
        card->setFileChooser(files);
        card->resize(900, 700);
    }

    template <typename Widget> Widget *find(const QString &name) const
    {
        auto *widget = card->findChild<Widget *>(name);
        if (!widget)
            qWarning("no widget named %s", qPrintable(name));
        return widget;
    }

    RecordingProgram program;
    MemorySettingsStore &store = program.store;
    RecordingStages *&stages = program.stages;
    FakeFileChooser files;
    std::function<void(CatalogSettings &)> fillLists;
    std::function<void(const QString &stage)> during;
    std::unique_ptr<MainCard> card;
};

// Types `text` into a widget key by key, as a keyboard would (QTest's own key clicks take Latin-1
// only).
inline void typeText(QWidget *widget, const QString &text)
{
    for (const QChar character : text)
        QTest::sendKeyEvent(QTest::Click, widget, Qt::Key_unknown, QString(character), Qt::NoModifier);
}

// Lists as a reachable accounting database fills them: three price lists, two note kinds.
inline void fillDemoLists(CatalogSettings &settings)
{
    for (ChoiceList *notes : {&settings.extraNote1, &settings.extraNote2, &settings.pictureNote}) {
        notes->addEntry(QStringLiteral("צבע"), 1);
        notes->addEntry(QStringLiteral("תמונה"), 2);
    }
    for (ChoiceList *prices : {&settings.priceList1, &settings.priceList2}) {
        prices->addEntry(QStringLiteral("מחיר הפריט"), 0);
        prices->addEntry(QStringLiteral("סיטונאי"), 3);
        prices->addEntry(QStringLiteral("קמעונאי"), 4);
    }
}

} // namespace zorbin::test
