#include "tests/common/TestMain.h"
#include "tests/common/ModalAnswer.h"
#include "tests/common/ScriptedAsker.h"
#include "tests/common/TempStore.h"

#include "host/client/GeneralSettings.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/domain/Property.h"
#include "host/store/DeleteDirItems.h"
#include "host/store/UpdateObjectResponse.h"
#include "host/domain/DirEntry.h"
#include "host/domain/Header.h"
#include "host/widgets/DirEntryBrowserWidget.h"
#include "host/widgets/DirEntryTreeModel.h"
#include "host/widgets/FolderBrowserWidget.h"
#include "host/widgets/FolderCommands.h"
#include "measurement/MeasurementConfigurationDialog.h"
#include "plugin/PellamSettingsKeys.h"

#include <QDialogButtonBox>
#include <QPushButton>
#include <QSplitter>
#include <QToolButton>
#include <QTreeView>

using namespace vemi;
using Node = BaseObjectTreeModel::Node;

namespace {

// Clicks OK in the next message box that opens above a modal dialog already
// running (ModalAnswer would find that dialog first); fails after 5 s.
void clickOkInNextMessageBoxAbove(QString* text)
{
    auto* timer = new QTimer(qApp);
    auto clock = std::make_shared<QElapsedTimer>();
    clock->start();
    QObject::connect(timer, &QTimer::timeout, [timer, clock, text]() {
        auto* box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
        if (!box && clock->elapsed() < 5000)
            return;
        timer->stop();
        timer->deleteLater();
        if (!box) {
            QApplication::activeModalWidget()->close();
            QTest::qFail("no message box appeared within 5 seconds", __FILE__, __LINE__);
            return;
        }
        *text = box->windowTitle() + ": " + box->text();
        box->button(QMessageBox::Ok)->click();
    });
    timer->start(10);
}

} // namespace

class tst_MeasurementConfigurationDialog : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleanup();

    void splitterDefaultsAndPersistence_data();
    void splitterDefaultsAndPersistence();
    void twoSelectedShowTheFirst();
    void clearedSelectionKeepsTheShownConfiguration();
    void newConfigurationsGetNumberedNames();
    void renamedEntry_data();
    void renamedEntry();
    void treeErrorClosesWithMinusOne();

private:
    std::unique_ptr<MeasurementConfigurationDialog> openDialog();
    DirEntryTreeModel* treeModel() const { return m_dialog->folderBrowser()->browser()->treeModel(); }
    QPushButton* okButton() const
    {
        return m_dialog->findChild<QDialogButtonBox*>("buttonBox")->button(QDialogButtonBox::Ok);
    }
    Node* node(const QString& name) const;
    // The name of the configuration the dialog would return; empty for none.
    QString shownName() const
    {
        const auto shown = m_dialog->measurementConfiguration();
        return shown ? QString::fromStdString(shown->name()) : QString();
    }
    void select(const QStringList& names);
    std::string store(const std::string& name, const std::string& model);

    std::unique_ptr<TempStore> m_store;
    std::unique_ptr<MeasurementConfigurationDialog> m_dialog;
    std::map<std::string, std::string> m_entryIds; // by name
};

void tst_MeasurementConfigurationDialog::init()
{
    QSettings().clear();
    m_store = std::make_unique<TempStore>();
    store("Alpha", "simcolorsphere");
    store("Beta", "simcolor45");
}

void tst_MeasurementConfigurationDialog::cleanup()
{
    m_dialog.reset();
    m_store.reset();
}

std::string tst_MeasurementConfigurationDialog::store(const std::string& name, const std::string& model)
{
    auto configuration = std::make_shared<MeasurementConfiguration>();
    configuration->setName(name);
    configuration->setInstrumentModel(model);
    const std::string topLevel;
    const auto answer = std::dynamic_pointer_cast<UpdateObjectResponse>(m_store->save(configuration, &topLevel));
    m_entryIds[name] = answer && answer->entry() ? answer->entry()->id() : std::string();
    return configuration->id();
}

std::unique_ptr<MeasurementConfigurationDialog> tst_MeasurementConfigurationDialog::openDialog()
{
    auto dialog = std::make_unique<MeasurementConfigurationDialog>(
        m_store->model(), std::make_shared<GeneralSettings>(std::vector<std::string>{""}, "D65", "10"));
    dialog->resize(1000, 600);
    return dialog;
}

Node* tst_MeasurementConfigurationDialog::node(const QString& name) const
{
    for (Node* candidate : treeModel()->descendants(treeModel()->root())) {
        if (candidate->displayName() == name)
            return candidate;
    }
    return nullptr;
}

void tst_MeasurementConfigurationDialog::select(const QStringList& names)
{
    QItemSelection selection;
    for (const QString& name : names) {
        Node* found = node(name);
        QVERIFY2(found, qPrintable(name));
        const QModelIndex index = treeModel()->indexFromNode(found);
        selection.select(index, index);
    }
    m_dialog->folderBrowser()->browser()->treeView()->selectionModel()->select(selection,
                                                                             QItemSelectionModel::ClearAndSelect);
}

void tst_MeasurementConfigurationDialog::splitterDefaultsAndPersistence_data()
{
    QTest::addColumn<int>("closeWith"); // a QDialogButtonBox::StandardButton
    QTest::newRow("OK") << int(QDialogButtonBox::Ok);
    QTest::newRow("Cancel") << int(QDialogButtonBox::Cancel);
}

void tst_MeasurementConfigurationDialog::splitterDefaultsAndPersistence()
{
    QFETCH(int, closeWith);
    m_dialog = openDialog();
    m_dialog->show();
    QVERIFY(QTest::qWaitForWindowExposed(m_dialog.get()));
    // Without a stored state the panes start at 200 and 600 (the browser at
    // least as wide as its names need) and then share the dialog's width.
    const QList<int> initial = m_dialog->splitter()->sizes();
    const int width = initial.at(0) + initial.at(1);
    const double browser = qMax(200, m_dialog->folderBrowser()->minimumSizeHint().width());
    const int expected = qRound(width * browser / (browser + 600));
    QVERIFY2(qAbs(initial.at(0) - expected) <= 2, qPrintable(QStringLiteral("%1 of %2").arg(initial.at(0)).arg(width)));
    m_dialog->hide();

    // The user drags the splitter, then closes the dialog.
    QList<int> dragged;
    ModalAnswer::actOnNextModal([&dragged, closeWith](QWidget* modal) {
        auto* dialog = static_cast<MeasurementConfigurationDialog*>(modal);
        dialog->splitter()->setSizes({560, 400});
        dragged = dialog->splitter()->sizes();
        auto* button = dialog->findChild<QDialogButtonBox*>("buttonBox")->button(QDialogButtonBox::StandardButton(closeWith));
        button->setEnabled(true);
        button->click();
    });
    m_dialog->exec();
    m_dialog.reset();
    QVERIFY(QSettings().contains(PellamKeys::DialogSplitterState));
    QVERIFY(dragged.first() > initial.at(0) + 50);

    m_dialog = openDialog();
    m_dialog->show();
    QVERIFY(QTest::qWaitForWindowExposed(m_dialog.get()));
    QCOMPARE(m_dialog->splitter()->sizes(), dragged);
}

void tst_MeasurementConfigurationDialog::twoSelectedShowTheFirst()
{
    m_dialog = openDialog();
    QTRY_VERIFY(node("Beta"));
    QVERIFY(!okButton()->isEnabled());
    select({"Beta", "Alpha"});
    QTRY_VERIFY(okButton()->isEnabled());
    // Beta was selected first.
    QCOMPARE(m_dialog->measurementConfiguration()->name(), std::string("Beta"));
    QCOMPARE(m_dialog->measurementConfiguration()->instrumentModel(), std::string("simcolor45"));
}

void tst_MeasurementConfigurationDialog::clearedSelectionKeepsTheShownConfiguration()
{
    m_dialog = openDialog();
    QTRY_VERIFY(node("Beta"));
    select({"Beta"});
    QTRY_VERIFY(okButton()->isEnabled());
    m_dialog->folderBrowser()->browser()->treeView()->clearSelection();
    QTRY_VERIFY(!okButton()->isEnabled());
    QCOMPARE(m_dialog->measurementConfiguration()->name(), std::string("Beta"));
}

void tst_MeasurementConfigurationDialog::newConfigurationsGetNumberedNames()
{
    m_dialog = openDialog();
    QTRY_VERIFY(node("Beta"));
    QToolButton* create = m_dialog->folderBrowser()->createButton();
    QCOMPARE(create->toolTip(), QStringLiteral("Create New Measurement Configuration"));

    for (const QString& name : {QStringLiteral("Measurement Configuration"), QStringLiteral("Measurement Configuration 2")}) {
        create->click();
        QTRY_VERIFY(node(name) && !node(name)->isModified());
        QTRY_COMPARE(shownName(), name);
        QTRY_VERIFY(okButton()->isEnabled());
    }
    // Stored, so that the next dialog lists them.
    const std::string id = m_dialog->measurementConfiguration()->id();
    const auto stored = m_store->fetch(MeasurementConfiguration::typeId(), id);
    QVERIFY(stored);
    QCOMPARE(stored->header()->name(), std::string("Measurement Configuration 2"));
}

void tst_MeasurementConfigurationDialog::renamedEntry_data()
{
    QTest::addColumn<QString>("renamed");
    QTest::addColumn<QString>("shownName");
    QTest::newRow("the entry shown takes its new name") << "Beta" << "Beta Renamed";
    QTest::newRow("another entry leaves the shown name alone") << "Alpha" << "Beta";
}

void tst_MeasurementConfigurationDialog::renamedEntry()
{
    QFETCH(QString, renamed);
    QFETCH(QString, shownName);
    m_dialog = openDialog();
    QTRY_VERIFY(node("Beta"));
    select({"Beta"});
    QTRY_VERIFY(okButton()->isEnabled());
    int changed = 0;
    connect(treeModel(), &DirEntryTreeModel::sgItemChanged, this, [&changed]() { ++changed; });

    ScriptedAsker asker;
    asker.scriptText(renamed + " Renamed");
    FolderCommands* commands = m_dialog->folderBrowser()->browser()->folderCommands();
    commands->setAsker(&asker);
    commands->rename(node(renamed));
    QTRY_COMPARE(changed, 1);
    commands->setAsker(nullptr);

    QCOMPARE(this->shownName(), shownName);
}

// An entry deleted elsewhere cannot be loaded: the tree model reports it,
// and the dialog closes after the message without a choice.
void tst_MeasurementConfigurationDialog::treeErrorClosesWithMinusOne()
{
    m_dialog = openDialog();
    QTRY_VERIFY(node("Beta"));
    QVERIFY(!m_store->run(std::make_shared<DeleteDirItems>(std::vector<std::string>{},
                                                            std::vector<std::string>{m_entryIds["Beta"]}))
                 .error);
    QString message;
    ModalAnswer::actOnNextModal([this, &message](QWidget*) {
        select({"Beta"});
        clickOkInNextMessageBoxAbove(&message);
    });
    QCOMPARE(m_dialog->exec(), -1);
    QVERIFY2(message.startsWith("Error Occurred: Cannot open \"Beta\""), qPrintable(message));
    QVERIFY(!okButton()->isEnabled());
}

QC_TEST_MAIN(tst_MeasurementConfigurationDialog)
#include "tst_measurementconfigurationdialog.moc"
