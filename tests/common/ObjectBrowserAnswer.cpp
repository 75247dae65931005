#include "tests/common/ObjectBrowserAnswer.h"

#include "tests/common/ModalAnswer.h"

#include "host/widgets/ObjectBrowserDialog.h"

#include <QComboBox>
#include <QDialogButtonBox>
#include <QPushButton>
#include <QTreeView>
#include <QtTest>

namespace ObjectBrowserAnswer {

void pickInNextDialog(QString store, QStringList path, QStringList entries, QString* title,
                      std::shared_ptr<vemi::SelectedPath>* openedAt, std::function<void()> beforeOk)
{
    ModalAnswer::actOnNextModal([=](QWidget* modal) {
        auto* dialog = qobject_cast<vemi::ObjectBrowserDialog*>(modal);
        if (!dialog) {
            modal->close();
            QFAIL("expected an object browser");
        }
        if (title)
            *title = dialog->windowTitle();
        if (openedAt)
            *openedAt = dialog->lastSelectedPath();
        if (entries.isEmpty()) {
            dialog->reject();
            return;
        }
        if (!store.isEmpty()) {
            auto* stores = dialog->findChild<QComboBox*>(QStringLiteral("dispatcherCombo"));
            stores->setCurrentIndex(stores->findText(store));
        }
        auto* tree = dialog->findChild<QTreeView*>(QStringLiteral("folderTree"));
        const auto find = [tree](const QModelIndex& parent, const QString& name) {
            for (int row = 0; tree->model() && row < tree->model()->rowCount(parent); ++row) {
                const QModelIndex index = tree->model()->index(row, 0, parent);
                if (index.data().toString() == name)
                    return index;
            }
            return QModelIndex();
        };
        const auto waitFor = [&](const QModelIndex& parent, const QString& name) {
            (void)QTest::qWaitFor([&] { return find(parent, name).isValid(); }, 5000);
            return find(parent, name);
        };
        QModelIndex folder;
        for (const QString& name : path) {
            folder = waitFor(folder, name);
            tree->expand(folder);
        }
        tree->selectionModel()->clearSelection();
        for (const QString& name : entries) {
            const QModelIndex at = waitFor(folder, name);
            if (!at.isValid()) {
                dialog->reject();
                QFAIL(qPrintable("the object browser does not list " + name));
            }
            tree->selectionModel()->select(at, QItemSelectionModel::Select | QItemSelectionModel::Rows);
            tree->selectionModel()->setCurrentIndex(at, QItemSelectionModel::NoUpdate);
        }
        if (beforeOk)
            beforeOk();
        dialog->findChild<QDialogButtonBox*>(QStringLiteral("buttonBox"))->button(QDialogButtonBox::Ok)->click();
        if (dialog->isVisible()) {
            dialog->reject();
            QFAIL("the object browser refused the choice");
        }
    });
}

} // namespace ObjectBrowserAnswer
