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
        QObject::connect(&m_timer, &QTimer::timeout, this, [this] { answer(); });
        m_timer.start(20);
    }

    QList<QMessageBox::StandardButton> buttons;
    QStringList texts;
    QList<QMessageBox::Icon> icons;
    std::function<void(QDialog *)> onDialog;

private:
    void answer()
    {
        QWidget *modal = QApplication::activeModalWidget();
        if (auto *box = qobject_cast<QMessageBox *>(modal)) {
            texts << box->text();
            icons << box->icon();
            QMessageBox::StandardButton pressed = QMessageBox::Ok;
            if (!buttons.isEmpty())
                pressed = buttons.takeFirst();
            else if (box->standardButtons() & QMessageBox::No)
                pressed = QMessageBox::No;
            if (QAbstractButton *button = box->button(pressed))
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
    std::optional<QString> chooseFolder(QWidget *, const QString &, const QString &) override
    {
        return answer;
    }

    std::optional<QString> answer;
    QList<FileRequest> fileRequests;
};

// The desktop program's parts as the program itself assembles them, over a given store.
struct AssembledProgram
{
    explicit AssembledProgram(SettingsStore &store) : control(assembleControl(user, store)) {}

    WidgetUserPort user;
    std::unique_ptr<CatalogControl> control;
};

// A settings card over an in-memory store and recording stages, assembled as the program
// assembles its parts. `fillLists` runs inside the start-up's list filling, as the accounting
// database would fill the lists; `during` inside each stage.
struct CardRig
{
    CardRig()
    {
        auto made = std::make_unique<RecordingStages>();
        stages = made.get();
        control = std::make_unique<CatalogControl>(user, store, localFileSystem(), std::move(made));
        stages->during = [this](const QString &stage) {
            if (stage == QLatin1String("FillCmbPriceField") && fillLists)
                fillLists(control->settings());
            if (during)
                during(stage);
        };
    }
    void start()
    {
        card = std::make_unique<MainCard>(*control, user);
        card->setFileChooser(files);
        card->resize(900, 700);
    }
    template <typename Widget = QWidget> Widget *find(const QString &name) const
    {
        auto *widget = card->findChild<Widget *>(name);
        if (!widget)
            qWarning("no widget named %s", qPrintable(name));
        return widget;
    }
    CatalogSettings &settings() { return control->settings(); }

    MemorySettingsStore store;
    WidgetUserPort user;
    RecordingStages *stages = nullptr;
    std::unique_ptr<CatalogControl> control;
    FakeFileChooser files;
    std::function<void(CatalogSettings &)> fillLists;
    std::function<void(const QString &stage)> during;
    std::unique_ptr<MainCard> card;
};

} // namespace zorbin::test
