#pragma once

#include <QMessageBox>

#include <functional>

class QWidget;

// Drives the next modal dialog from a timer, since exec() blocks the test:
// waits for it to appear, then acts on it.
namespace ModalAnswer {

// Clicks button in the next modal message box; the box's text is kept in *text.
void clickInNextMessageBox(QMessageBox::StandardButton button, QString* text = nullptr);
void actOnNextModal(std::function<void(QWidget*)> action);

} // namespace ModalAnswer
