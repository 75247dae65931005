#include "tests/common/ModalAnswer.h"

#include <QAbstractButton>
#include <QApplication>
#include <QDialog>
#include <QElapsedTimer>
#include <QTimer>
#include <QtTest>

namespace ModalAnswer {

namespace {

constexpr int kDeadlineMs = 5000;

QByteArray currentTest()
{
    return QByteArray(QTest::currentTestFunction()) + '/' + QByteArray(QTest::currentDataTag());
}

// Closes a dialog the test did not expect, so that its exec() returns.
void dismiss(QWidget* modal)
{
    if (auto* dialog = qobject_cast<QDialog*>(modal))
        dialog->reject();
    else
        modal->close();
}

} // namespace

void actOnNextModal(std::function<void(QWidget*)> action)
{
    const QByteArray test = currentTest();
    auto* timer = new QTimer(qApp);
    auto clock = std::make_shared<QElapsedTimer>();
    clock->start();
    timer->setInterval(10);
    QObject::connect(timer, &QTimer::timeout, [timer, action, test, clock]() {
        const auto stop = [timer] {
            timer->stop();
            timer->deleteLater();
        };
        if (currentTest() != test) {
            stop();
            return;
        }
        if (QWidget* modal = QApplication::activeModalWidget()) {
            stop();
            action(modal);
            return;
        }
        if (clock->elapsed() > kDeadlineMs) {
            stop();
            QTest::qFail("no modal dialog appeared within 5 seconds", __FILE__, __LINE__);
        }
    });
    timer->start();
}

void clickInNextMessageBox(QMessageBox::StandardButton button, QString* text)
{
    actOnNextModal([button, text](QWidget* modal) {
        auto* box = qobject_cast<QMessageBox*>(modal);
        QAbstractButton* target = box ? box->button(button) : nullptr;
        if (!target) {
            dismiss(modal);
            QTest::qFail(qPrintable(QStringLiteral("expected a message box with that button, got a %1")
                                        .arg(QLatin1String(modal->metaObject()->className()))),
                         __FILE__, __LINE__);
            return;
        }
        if (text)
            *text = box->text();
        target->click();
    });
}

} // namespace ModalAnswer
