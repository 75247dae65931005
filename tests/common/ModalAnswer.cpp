#include "tests/common/ModalAnswer.h"

#include <QAbstractButton>
#include <QApplication>
#include <QTimer>

namespace ModalAnswer {

void actOnNextModal(std::function<void(QWidget*)> action)
{
    auto* timer = new QTimer;
    timer->setInterval(10);
    QObject::connect(timer, &QTimer::timeout, [timer, action]() {
        QWidget* modal = QApplication::activeModalWidget();
        if (!modal)
            return;
        timer->stop();
        timer->deleteLater();
        action(modal);
    });
    timer->start();
}

void clickInNextMessageBox(QMessageBox::StandardButton button, QString* text)
{
    actOnNextModal([button, text](QWidget* modal) {
        auto* box = qobject_cast<QMessageBox*>(modal);
        if (!box)
            return;
        if (text)
            *text = box->text();
        box->button(button)->click();
    });
}

} // namespace ModalAnswer
