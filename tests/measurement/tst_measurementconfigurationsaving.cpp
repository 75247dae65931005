#include "tests/common/TestMain.h"
#include "tests/common/ModalAnswer.h"
#include "tests/common/TempStore.h"

#include "detail/QCJobTemplateDetailWidget.h"
#include "host/client/GeneralSettings.h"
#include "host/domain/Header.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/domain/QCJobTemplate.h"
#include "host/widgets/BaseObjectTreeModel.h"
#include "host/widgets/DirEntryBrowserWidget.h"
#include "host/widgets/DirEntryTreeModel.h"
#include "host/widgets/FolderBrowserWidget.h"
#include "measurement/MeasurementConfigurationDialog.h"
#include "model/QCJobTemplateModel.h"

#include <QDialogButtonBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTabWidget>
#include <QTreeView>

Q_DECLARE_METATYPE(std::shared_ptr<vemi::QCJobTemplate>)

using namespace vemi;

// The editor's "Set Measurement Configuration": the dialog, the template, and
// the configuration stored at once.
class tst_MeasurementConfigurationSaving : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase();
    void init();
    void cleanup();

    void chosenConfigurationIsStoredAndShown();
    void cancelledDialogChangesNothing();
    void refusedStoreIsReportedAndTheChoiceKept();

private:
    template <class T>
    T* child(const char* name) const { return m_widget->findChild<T*>(QLatin1String(name)); }
    // Clicks the button and, in the dialog, selects name, types description, presses button.
    void chooseInDialog(const QString& name, const QString& description, QDialogButtonBox::StandardButton button);

    std::unique_ptr<TempStore> m_store;
    std::shared_ptr<QCJobTemplateModel> m_model;
    std::unique_ptr<QCJobTemplateDetailWidget> m_widget;
    std::shared_ptr<MeasurementConfiguration> m_stored;
};

void tst_MeasurementConfigurationSaving::initTestCase()
{
    qRegisterMetaType<std::shared_ptr<QCJobTemplate>>("std::shared_ptr<vemi::QCJobTemplate>");
}

void tst_MeasurementConfigurationSaving::init()
{
    QSettings().clear();
    m_store = std::make_unique<TempStore>();
    m_stored = std::make_shared<MeasurementConfiguration>();
    m_stored->setName("Sphere D65");
    m_stored->setInstrumentModel("simcolorsphere");
    const std::string topLevel;
    QVERIFY(m_store->save(m_stored, &topLevel));

    m_model = std::make_shared<QCJobTemplateModel>(m_store->model());
    auto settings = std::make_shared<GeneralSettings>(std::vector<std::string>{""}, "D65", "10");
    m_widget = std::make_unique<QCJobTemplateDetailWidget>(m_store->model(), nullptr, m_model, settings);
    auto jobTemplate = std::make_shared<QCJobTemplate>();
    jobTemplate->setName("Door");
    m_model->setJobTemplate(jobTemplate);
    m_widget->reloadFromModel();
}

void tst_MeasurementConfigurationSaving::cleanup()
{
    m_widget.reset();
    m_model.reset();
    m_store.reset();
}

void tst_MeasurementConfigurationSaving::chooseInDialog(const QString& name, const QString& description,
                                                        QDialogButtonBox::StandardButton button)
{
    ModalAnswer::actOnNextModal([name, description, button](QWidget* modal) {
        auto* dialog = qobject_cast<MeasurementConfigurationDialog*>(modal);
        QVERIFY(dialog);
        DirEntryTreeModel* tree = dialog->folderBrowser()->browser()->treeModel();
        QTRY_COMPARE(tree->rowCount(), 1);
        QVERIFY(tree->root()->children().front()->displayName() == name);
        dialog->folderBrowser()->browser()->treeView()->setCurrentIndex(tree->index(0, 0));
        QPushButton* ok = dialog->findChild<QDialogButtonBox*>("buttonBox")->button(QDialogButtonBox::Ok);
        QTRY_VERIFY(ok->isEnabled());
        dialog->findChild<QLineEdit*>("descLineEdit")->setText(description);
        dialog->findChild<QDialogButtonBox*>("buttonBox")->button(button)->click();
    });
    child<QAbstractButton>("addMeasurementConfigurationButton")->click();
}

void tst_MeasurementConfigurationSaving::chosenConfigurationIsStoredAndShown()
{
    QSignalSpy modified(m_widget.get(), &QCJobTemplateDetailWidget::sgJobTemplateWasModified);
    QVERIFY(child<QLabel>("needMeasureConfigNotice")->isVisibleTo(m_widget.get()));

    chooseInDialog("Sphere D65", "For large parts", QDialogButtonBox::Ok);

    QCOMPARE(child<QLabel>("MeasConfigurationNameLabel")->text(), QStringLiteral("Sphere D65"));
    QVERIFY(!child<QLabel>("needMeasureConfigNotice")->isVisibleTo(m_widget.get()));
    QCOMPARE(modified.count(), 1);
    QCOMPARE(m_model->jobTemplate()->measurementConfiguration()->id(), m_stored->id());
    // The store takes the edits made in the dialog, the whole settings list included.
    std::shared_ptr<BaseObject> stored;
    QTRY_VERIFY((stored = m_store->fetch(MeasurementConfiguration::typeId(), m_stored->id()))
                && stored->header()->description() == "For large parts");
    QCOMPARE(int(std::static_pointer_cast<MeasurementConfiguration>(stored)->properties().size()), 5);
}

void tst_MeasurementConfigurationSaving::cancelledDialogChangesNothing()
{
    QSignalSpy modified(m_widget.get(), &QCJobTemplateDetailWidget::sgJobTemplateWasModified);
    chooseInDialog("Sphere D65", "Never stored", QDialogButtonBox::Cancel);

    QVERIFY(child<QLabel>("MeasConfigurationNameLabel")->text().isEmpty());
    QVERIFY(!m_model->jobTemplate()->measurementConfiguration());
    QCOMPARE(modified.count(), 0);
    QTest::qWait(50);
    QVERIFY(m_store->fetch(MeasurementConfiguration::typeId(), m_stored->id())->header()->description().empty());
}

// The store refuses the write: the box names the store's reason, and the
// template keeps the configuration it took.
void tst_MeasurementConfigurationSaving::refusedStoreIsReportedAndTheChoiceKept()
{
    m_widget.reset();
    m_model.reset();
    m_store->reopenReadOnly();
    m_model = std::make_shared<QCJobTemplateModel>(m_store->model());
    m_model->setJobTemplate(std::make_shared<QCJobTemplate>());
    m_widget = std::make_unique<QCJobTemplateDetailWidget>(m_store->model(), nullptr, m_model, nullptr);
    m_widget->reloadFromModel();

    chooseInDialog("Sphere D65", "Edited", QDialogButtonBox::Ok);
    QString shown;
    ModalAnswer::actOnNextModal([&shown](QWidget* modal) {
        auto* box = qobject_cast<QMessageBox*>(modal);
        QVERIFY(box);
        shown = box->windowTitle() + "|" + box->text();
        box->button(QMessageBox::Ok)->click();
    });
    QTRY_VERIFY(!shown.isEmpty());

    QVERIFY2(shown.startsWith("Not ok|Unable to save: "), qPrintable(shown));
    QVERIFY2(shown.contains("read-only"), qPrintable(shown));
    QCOMPARE(child<QLabel>("MeasConfigurationNameLabel")->text(), QStringLiteral("Sphere D65"));
    QCOMPARE(m_model->jobTemplate()->measurementConfiguration()->id(), m_stored->id());
}

QC_TEST_MAIN(tst_MeasurementConfigurationSaving)
#include "tst_measurementconfigurationsaving.moc"
