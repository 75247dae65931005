#include "tests/common/ModalAnswer.h"
#include "tests/common/TestMain.h"
#include "tests/common/TempStore.h"

#include "host/domain/GlobalDirEntry.h"
#include "host/domain/Header.h"
#include "host/domain/Standard.h"
#include "host/store/CreateFolder.h"
#include "host/store/DeleteDirItems.h"
#include "host/store/FolderResponse.h"
#include "host/store/UpdateObject.h"
#include "host/widgets/ObjectBrowserDialog.h"
#include "host/widgets/SelectedPath.h"

#include <QComboBox>
#include <QDialogButtonBox>
#include <QLabel>
#include <QPushButton>
#include <QStandardItemModel>
#include <QTreeView>
#include <QtTest>

using namespace vemi;

namespace {

const char* const kSecondStore = "Plant 2";
const char* const kMissingStore = "Plant 9";

std::vector<std::string> toPath(const QStringList& names)
{
    std::vector<std::string> path;
    for (const QString& name : names)
        path.push_back(name.toStdString());
    return path;
}

QTreeView* tree(QDialog& dialog)
{
    return dialog.findChild<QTreeView*>(QStringLiteral("folderTree"));
}

QModelIndex indexOf(QTreeView* view, const QStringList& names)
{
    const QAbstractItemModel* model = view->model();
    QModelIndex found;
    for (const QString& name : names) {
        const QModelIndex parent = found;
        found = {};
        for (int row = 0; model && row < model->rowCount(parent) && !found.isValid(); ++row) {
            if (model->index(row, 0, parent).data().toString() == name)
                found = model->index(row, 0, parent);
        }
        if (!found.isValid())
            return {};
    }
    return found;
}

void ctrlClick(QTreeView* view, const QModelIndex& index)
{
    view->scrollTo(index);
    QTest::mouseClick(view->viewport(), Qt::LeftButton, Qt::ControlModifier, view->visualRect(index).center());
}

// A view acts on a double click only where the press before it landed.
void doubleClick(QTreeView* view, const QModelIndex& index)
{
    view->scrollTo(index);
    const QPoint at = view->visualRect(index).center();
    QTest::mouseClick(view->viewport(), Qt::LeftButton, {}, at);
    QTest::mouseDClick(view->viewport(), Qt::LeftButton, {}, at);
}

QPushButton* okButton(QDialog& dialog)
{
    return dialog.findChild<QDialogButtonBox*>(QStringLiteral("buttonBox"))->button(QDialogButtonBox::Ok);
}

} // namespace

// Two real store files in one model. The default store ("Local") holds the
// standard "Local Beige" and the folder "Charts" with "Local Chart Red"; the
// second store holds a folder "Charts" too (same name, other content) with
// "Remote Red", "Remote Blue" and the subfolder "Deep/er", and a folder "Old".
class tst_ObjectBrowserDialog : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleanup();
    void picksEntriesOfTheChosenStore();
    void opensRememberedPlace_data();
    void opensRememberedPlace();
    void okNeedsAnEntry();
    void storeWithoutFileCannotBeChosen();
    void modalDoubleClickAccepts();

private:
    std::string createFolder(const std::string& dispatcherId, const std::string& parentId, const std::string& name);
    std::string saveStandard(const std::string& dispatcherId, const std::string& folderId, const std::string& name);
    std::unique_ptr<ObjectBrowserDialog> makeDialog(std::shared_ptr<SelectedPath> path, bool show = true);

    std::unique_ptr<TempStore> m_store;
    std::map<std::string, std::string> m_ids; // object ids by standard name
    std::string m_oldFolderId;
};

void tst_ObjectBrowserDialog::init()
{
    m_store = std::make_unique<TempStore>();
    m_store->model().addStore(kSecondStore, m_store->folder() + QStringLiteral("/plant2.sqlite"));
    m_ids.clear();
    saveStandard("", "", "Local Beige");
    saveStandard("", createFolder("", "", "Charts"), "Local Chart Red");
    const std::string charts = createFolder(kSecondStore, "", "Charts");
    saveStandard(kSecondStore, charts, "Remote Red");
    saveStandard(kSecondStore, charts, "Remote Blue");
    saveStandard(kSecondStore, createFolder(kSecondStore, charts, "Deep/er"), "Remote Deep");
    m_oldFolderId = createFolder(kSecondStore, "", "Old");
    saveStandard(kSecondStore, m_oldFolderId, "Remote Old");
}

void tst_ObjectBrowserDialog::cleanup()
{
    m_store.reset();
}

std::string tst_ObjectBrowserDialog::createFolder(const std::string& dispatcherId, const std::string& parentId,
                                                  const std::string& name)
{
    const auto answer = m_store->run(std::make_shared<CreateFolder>(Standard::typeId(), parentId, name), dispatcherId);
    const auto folder = std::dynamic_pointer_cast<FolderResponse>(answer.response);
    return folder ? folder->folder().id : std::string();
}

std::string tst_ObjectBrowserDialog::saveStandard(const std::string& dispatcherId, const std::string& folderId,
                                                  const std::string& name)
{
    auto standard = std::make_shared<Standard>();
    standard->setName(name);
    auto update = std::make_shared<UpdateObject>();
    update->setObject(standard);
    update->setFolderId(folderId);
    if (!m_store->run(update, dispatcherId).response)
        qWarning("could not save %s", name.c_str());
    m_ids[name] = standard->id();
    return standard->id();
}

// Set up as the template editor's pickers do, then shown unless run modal.
std::unique_ptr<ObjectBrowserDialog> tst_ObjectBrowserDialog::makeDialog(std::shared_ptr<SelectedPath> path, bool show)
{
    auto dialog = std::make_unique<ObjectBrowserDialog>(m_store->model(), nullptr);
    dialog->initialize(true, false, {Standard::typeId()}, QStringLiteral("Add selected standard(s)"), false);
    dialog->setDispatcherList({"", kSecondStore, kMissingStore});
    dialog->setLastSelectedPath(std::move(path));
    if (show)
        dialog->show();
    return dialog;
}

void tst_ObjectBrowserDialog::picksEntriesOfTheChosenStore()
{
    auto dialog = makeDialog(nullptr);
    QTreeView* view = tree(*dialog);
    QTRY_VERIFY(indexOf(view, {"Local Beige"}).isValid());

    auto* stores = dialog->findChild<QComboBox*>(QStringLiteral("dispatcherCombo"));
    stores->setCurrentIndex(stores->findText(kSecondStore));
    QTRY_VERIFY(indexOf(view, {"Old"}).isValid());
    QVERIFY(!indexOf(view, {"Local Beige"}).isValid());
    const QModelIndex charts = indexOf(view, {"Charts"});
    doubleClick(view, charts);
    QVERIFY(view->isExpanded(charts));
    QVERIFY(dialog->isVisible()); // a folder is no choice

    ctrlClick(view, indexOf(view, {"Charts", "Remote Red"}));
    ctrlClick(view, indexOf(view, {"Charts", "Remote Blue"}));
    QTest::mouseClick(okButton(*dialog), Qt::LeftButton);

    QCOMPARE(dialog->result(), int(QDialog::Accepted));
    const auto entries = dialog->selectedDirEntries();
    QCOMPARE(entries.size(), 2);
    QCOMPARE(entries[0]->header()->name(), std::string("Remote Red"));
    QCOMPARE(entries[1]->header()->name(), std::string("Remote Blue"));
    for (const auto& entry : entries) {
        QCOMPARE(entry->dispatcherId(), std::string(kSecondStore));
        QCOMPARE(entry->entryObjectId(), m_ids[entry->header()->name()]);
        QCOMPARE(entry->entryObjectType(), Standard::typeId());
    }
    QCOMPARE(dialog->lastSelectedPath()->dispatcherId(), std::string(kSecondStore));
    QCOMPARE(dialog->lastSelectedPath()->path(), toPath({"Charts"}));
}

void tst_ObjectBrowserDialog::opensRememberedPlace_data()
{
    QTest::addColumn<QString>("dispatcherId");
    QTest::addColumn<QStringList>("path");
    QTest::addColumn<bool>("deleteOldFolder");
    QTest::addColumn<QString>("expectedStore");
    QTest::addColumn<QStringList>("expectedFolder"); // empty: the top level

    QTest::newRow("nested folder in the second store reopens there")
        << kSecondStore << QStringList{"Charts", "Deep/er"} << false << kSecondStore
        << QStringList{"Charts", "Deep/er"};
    QTest::newRow("folder of the same name reopens in the default store")
        << "" << QStringList{"Charts"} << false << "Local" << QStringList{"Charts"};
    QTest::newRow("default store under its own id") << "Local" << QStringList{"Charts"} << false << "Local"
                                                    << QStringList{"Charts"};
    QTest::newRow("deleted folder falls back to the top level")
        << kSecondStore << QStringList{"Old"} << true << kSecondStore << QStringList();
    QTest::newRow("folder that never existed falls back to the top level")
        << kSecondStore << QStringList{"Charts", "Gone"} << false << kSecondStore << QStringList();
    QTest::newRow("store not in the list opens the first store")
        << "Plant 7" << QStringList{"Charts"} << false << "Local" << QStringList();
    QTest::newRow("store without a file opens the first store")
        << kMissingStore << QStringList{"Charts"} << false << "Local" << QStringList();
}

void tst_ObjectBrowserDialog::opensRememberedPlace()
{
    QFETCH(QString, dispatcherId);
    QFETCH(QStringList, path);
    QFETCH(bool, deleteOldFolder);
    QFETCH(QString, expectedStore);
    QFETCH(QStringList, expectedFolder);

    if (deleteOldFolder)
        QVERIFY(m_store->run(std::make_shared<DeleteDirItems>(std::vector<std::string>{m_oldFolderId},
                                                              std::vector<std::string>{}),
                             kSecondStore).response);
    auto dialog = makeDialog(std::make_shared<SelectedPath>(dispatcherId.toStdString(), toPath(path)));
    QTreeView* view = tree(*dialog);
    QTRY_VERIFY(indexOf(view, {"Charts"}).isValid());
    QTRY_VERIFY(dialog->findChild<QLabel*>(QStringLiteral("statusLabel"))->text().isEmpty());

    QCOMPARE(dialog->findChild<QComboBox*>(QStringLiteral("dispatcherCombo"))->currentText(), expectedStore);
    if (expectedFolder.isEmpty()) {
        QVERIFY(!view->currentIndex().isValid());
        QVERIFY(!view->isExpanded(indexOf(view, {"Charts"})));
    } else {
        QTRY_COMPARE(view->currentIndex(), indexOf(view, expectedFolder));
        QVERIFY(view->isExpanded(view->currentIndex())); // its entries are in sight
    }
    // Choosing an entry without moving the current folder keeps the place.
    const QStringList entry = expectedStore == "Local" ? QStringList{"Local Beige"} : QStringList{"Charts", "Remote Red"};
    view->selectionModel()->select(indexOf(view, entry), QItemSelectionModel::Select | QItemSelectionModel::Rows);
    QTest::mouseClick(okButton(*dialog), Qt::LeftButton);
    QCOMPARE(dialog->result(), int(QDialog::Accepted));
    const std::string storeId = dialog->lastSelectedPath()->dispatcherId();
    QCOMPARE(QString::fromStdString(storeId.empty() ? "Local" : storeId), expectedStore);
    QCOMPARE(dialog->lastSelectedPath()->path(), toPath(expectedFolder));
}

void tst_ObjectBrowserDialog::okNeedsAnEntry()
{
    auto dialog = makeDialog(std::make_shared<SelectedPath>("", toPath({"Charts"})));
    QTreeView* view = tree(*dialog);
    QTRY_VERIFY(indexOf(view, {"Charts", "Local Chart Red"}).isValid());
    QTRY_VERIFY(view->isExpanded(indexOf(view, {"Charts"})));
    QVERIFY(!okButton(*dialog)->isEnabled());

    ctrlClick(view, indexOf(view, {"Charts"}));
    QVERIFY(view->selectionModel()->isSelected(indexOf(view, {"Charts"})));
    QVERIFY(!okButton(*dialog)->isEnabled());
    QTest::keyClick(view, Qt::Key_Return);
    QVERIFY(dialog->isVisible());

    ctrlClick(view, indexOf(view, {"Charts", "Local Chart Red"}));
    QVERIFY(okButton(*dialog)->isEnabled());
    ctrlClick(view, indexOf(view, {"Charts", "Local Chart Red"}));
    QVERIFY(!okButton(*dialog)->isEnabled());
}

void tst_ObjectBrowserDialog::storeWithoutFileCannotBeChosen()
{
    auto dialog = makeDialog(nullptr);
    auto* combo = dialog->findChild<QComboBox*>(QStringLiteral("dispatcherCombo"));
    QCOMPARE(combo->count(), 3);
    const int row = combo->findData(QString(kMissingStore));
    QVERIFY(row >= 0);
    QVERIFY(combo->itemText(row).contains(kMissingStore));
    QVERIFY(combo->itemText(row) != kMissingStore); // says why it cannot be chosen
    QVERIFY(!qobject_cast<QStandardItemModel*>(combo->model())->item(row)->isEnabled());
}

void tst_ObjectBrowserDialog::modalDoubleClickAccepts()
{
    auto dialog = makeDialog(std::make_shared<SelectedPath>(kSecondStore, toPath({"Charts", "Deep/er"})), false);

    ModalAnswer::actOnNextModal([](QWidget* modal) {
        QTreeView* view = modal->findChild<QTreeView*>(QStringLiteral("folderTree"));
        QModelIndex deep;
        QTRY_VERIFY_WITH_TIMEOUT((deep = indexOf(view, {"Charts", "Deep/er", "Remote Deep"})).isValid(), 5000);
        QTRY_VERIFY(view->isExpanded(deep.parent()));
        doubleClick(view, deep);
    });
    QCOMPARE(dialog->exec(), int(QDialog::Accepted));

    const auto entries = dialog->selectedDirEntries();
    QCOMPARE(entries.size(), 1);
    QCOMPARE(entries[0]->header()->name(), std::string("Remote Deep"));
    QCOMPARE(entries[0]->dispatcherId(), std::string(kSecondStore));
    QCOMPARE(dialog->lastSelectedPath()->path(), toPath({"Charts", "Deep/er"}));
}

QC_TEST_MAIN(tst_ObjectBrowserDialog)
#include "tst_objectbrowserdialog.moc"
