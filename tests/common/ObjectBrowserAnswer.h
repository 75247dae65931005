#pragma once

#include <QString>
#include <QStringList>

#include <functional>
#include <memory>

namespace vemi {
class SelectedPath;
}

// Answers the next modal object browser from a timer (see ModalAnswer).
namespace ObjectBrowserAnswer {

// Chooses store in the next object browser, opens the folders of path,
// selects the entries there, runs beforeOk and presses OK; no entries cancel
// the dialog instead. The dialog's title and the place it opened at are kept
// when asked for. The dialog is closed in every case; another kind of modal
// dialog fails the test.
void pickInNextDialog(QString store, QStringList path, QStringList entries, QString* title = nullptr,
                      std::shared_ptr<vemi::SelectedPath>* openedAt = nullptr, std::function<void()> beforeOk = {});

} // namespace ObjectBrowserAnswer
