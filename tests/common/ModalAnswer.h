#pragma once

#include <QMessageBox>

#include <functional>

class QWidget;

// Drives the next modal dialog from a timer, since exec() blocks the test:
// waits for it to appear, then acts on it. The wait belongs to the test
// function (and data row) that started it: it ends with that test, and fails
// the test when no modal dialog appeared within a few seconds.
namespace ModalAnswer {

// Clicks button in the next modal message box; the box's text is kept in *text.
// Another kind of dialog, or a box without that button, is closed and fails the test.
void clickInNextMessageBox(QMessageBox::StandardButton button, QString* text = nullptr);
void actOnNextModal(std::function<void(QWidget*)> action);

} // namespace ModalAnswer
