#include "tests/common/TestMain.h"
#include "tests/common/CheckListText.h"
#include "tests/common/RecordingDispatcher.h"
#include "tests/common/TempStore.h"

#include "host/domain/CheckPoint.h"
#include "host/domain/ColorStandardsLibrary.h"
#include "host/store/GetMarloObjects.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/domain/Position.h"
#include "host/domain/QCJobTemplate.h"
#include "model/QCJobTemplateModel.h"
#include "host/domain/SchematicImage.h"
#include "host/domain/Size.h"
#include "host/domain/Standard.h"
#include "host/domain/TagDefinition.h"
#include "host/domain/TagValue.h"
#include "host/domain/ToleranceSet.h"
#include "host/store/UpdateObject.h"

#include <QtTest>

#include <functional>

using namespace vemi;

class tst_QCJobTemplateModel : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleanup();
    void newModelHoldsNoTemplate();
    void setJobTemplateRequestsLibrariesFirst();
    void saveSendsTheVeryTemplate();
    void saveStoresTemplateInRealStore();
    void editsChangeTemplateSilently_data();
    void editsChangeTemplateSilently();
    void notifyEmitsOnceAndChangesNothing();
    void measurementConfigurationIsAnnounced_data();
    void measurementConfigurationIsAnnounced();
    void editedTemplateSurvivesTheStore();

private:
    std::unique_ptr<TempStore> m_store;
    std::shared_ptr<RecordingDispatcher> m_recorder;
};

void tst_QCJobTemplateModel::init()
{
    m_store = std::make_unique<TempStore>();
    m_recorder = std::make_shared<RecordingDispatcher>();
    m_store->model().setCommandDispatcher("", m_recorder);
}

void tst_QCJobTemplateModel::cleanup()
{
    m_store.reset();
    m_recorder.reset();
}

void tst_QCJobTemplateModel::newModelHoldsNoTemplate()
{
    QCJobTemplateModel model(m_store->model());
    QVERIFY(!model.jobTemplate());
    QVERIFY(m_recorder->commands().empty());
}

void tst_QCJobTemplateModel::setJobTemplateRequestsLibrariesFirst()
{
    QCJobTemplateModel model(m_store->model());
    QSignalSpy loaded(&model, &QCJobTemplateModel::sgMeasurementConfigLoaded);
    QSignalSpy savable(&model, &QCJobTemplateModel::sgSetTemplateSavable);
    auto first = std::make_shared<QCJobTemplate>();
    auto second = std::make_shared<QCJobTemplate>();
    model.setJobTemplate(first);

    // The request must leave before the template changes hands.
    std::shared_ptr<QCJobTemplate> heldWhenRequested;
    m_recorder->onDispatch = [&](const std::shared_ptr<Command>&) { heldWhenRequested = model.jobTemplate(); };
    model.setJobTemplate(second);

    const auto requests = m_recorder->commandsOf<GetMarloObjects>();
    QCOMPARE(m_recorder->commands().size(), size_t(2));
    QCOMPARE(requests.size(), size_t(2));
    for (const auto& request : requests) {
        QCOMPARE(request->type(), ColorStandardsLibrary::typeId());
        QVERIFY(request->ids().empty());
    }
    QCOMPARE(heldWhenRequested, first);
    QCOMPARE(model.jobTemplate(), second);
    QCOMPARE(loaded.count(), 0);
    QCOMPARE(savable.count(), 0);
}

void tst_QCJobTemplateModel::saveSendsTheVeryTemplate()
{
    QCJobTemplateModel model(m_store->model());
    auto jobTemplate = std::make_shared<QCJobTemplate>();
    model.setJobTemplate(jobTemplate);
    m_recorder->clear();
    model.saveJobTemplate();

    const auto updates = m_recorder->commandsOf<UpdateObject>();
    QCOMPARE(m_recorder->commands().size(), size_t(1));
    QCOMPARE(updates.size(), size_t(1));
    QCOMPARE(updates.front()->object().get(), static_cast<BaseObject*>(jobTemplate.get()));
}

void tst_QCJobTemplateModel::saveStoresTemplateInRealStore()
{
    TempStore store;
    QCJobTemplateModel model(store.model());
    auto jobTemplate = std::make_shared<QCJobTemplate>();
    jobTemplate->setName("Saved at once");
    model.setJobTemplate(jobTemplate);
    model.saveJobTemplate();
    // The store runs commands in order, so a fetch after the save sees it.
    const auto stored = std::dynamic_pointer_cast<QCJobTemplate>(store.fetch(QCJobTemplate::typeId(), jobTemplate->id()));
    QVERIFY(stored);
    QCOMPARE(stored->name(), std::string("Saved at once"));
}

using Edit = std::function<void(QCJobTemplateModel&)>;
using Check = std::function<bool(const QCJobTemplate&)>;
Q_DECLARE_METATYPE(Edit)
Q_DECLARE_METATYPE(Check)
Q_DECLARE_METATYPE(std::shared_ptr<vemi::MeasurementConfiguration>)

void tst_QCJobTemplateModel::editsChangeTemplateSilently_data()
{
    QTest::addColumn<Edit>("edit");
    QTest::addColumn<Check>("check");
    auto definition = std::make_shared<TagDefinition>();
    definition->setName("Supplier");
    auto value = TagValue::forDefinition(*definition, "Acme Plastics");

    QTest::newRow("description") << Edit([](QCJobTemplateModel& m) { m.setDescription("Größe ✓"); })
                                 << Check([](const QCJobTemplate& t) { return t.description() == "Größe ✓"; });
    QTest::newRow("repeat flag") << Edit([](QCJobTemplateModel& m) { m.setEnableRepeat(true); })
                                 << Check([](const QCJobTemplate& t) { return t.enableRepeat(); });
    QTest::newRow("tag definitions")
        << Edit([definition](QCJobTemplateModel& m) { m.setTagDefinitions({definition}); })
        << Check([definition](const QCJobTemplate& t) { return t.tagDefinitions() == std::vector{definition}; });
    QTest::newRow("tag values") << Edit([value](QCJobTemplateModel& m) { m.setTagValues({value}); })
                                << Check([value](const QCJobTemplate& t) { return t.tagValues() == std::vector{value}; });

    const auto red = std::make_shared<Standard>();
    const auto blue = std::make_shared<Standard>();
    const auto library = std::make_shared<ColorStandardsLibrary>();
    library->setStandards({blue, red});
    const auto emptyLibrary = std::make_shared<ColorStandardsLibrary>();
    QTest::newRow("the same standard added twice gives two entries")
        << Edit([red](QCJobTemplateModel& m) { m.addStandard(red); m.addStandard(red); })
        << Check([red](const QCJobTemplate& t) { return t.standards() == std::vector{red, red}; });
    QTest::newRow("a null standard is not added")
        << Edit([red](QCJobTemplateModel& m) { m.addStandard(red); m.addStandard(nullptr); })
        << Check([red](const QCJobTemplate& t) { return t.standards() == std::vector{red}; });
    QTest::newRow("a library replaces all standards in its order")
        << Edit([red, library](QCJobTemplateModel& m) { m.addStandard(red); m.setStandardsFromLibrary(library); })
        << Check([red, blue](const QCJobTemplate& t) { return t.standards() == std::vector{blue, red}; });
    QTest::newRow("a library without standards keeps them")
        << Edit([red, emptyLibrary](QCJobTemplateModel& m) { m.addStandard(red); m.setStandardsFromLibrary(emptyLibrary); })
        << Check([red](const QCJobTemplate& t) { return t.standards() == std::vector{red}; });
    QTest::newRow("remove all standards")
        << Edit([red](QCJobTemplateModel& m) { m.addStandard(red); m.removeAllStandards(); })
        << Check([](const QCJobTemplate& t) { return t.standards().empty(); });

    const auto tolerance = std::make_shared<ToleranceSet>();
    QTest::newRow("shared tolerance sets")
        << Edit([tolerance](QCJobTemplateModel& m) { m.setSharedToleranceSets({tolerance}); })
        << Check([tolerance](const QCJobTemplate& t) { return t.sharedToleranceSets() == std::vector{tolerance}; });
    QTest::newRow("remove all tolerance sets, shared and private")
        << Edit([tolerance](QCJobTemplateModel& m) {
               m.setSharedToleranceSets({tolerance});
               m.jobTemplate()->setPrivateToleranceSets({tolerance});
               m.removeAllToleranceSets();
           })
        << Check([](const QCJobTemplate& t) {
               return t.sharedToleranceSets().empty() && t.privateToleranceSets().empty();
           });
}

void tst_QCJobTemplateModel::editsChangeTemplateSilently()
{
    QFETCH(Edit, edit);
    QFETCH(Check, check);
    QCJobTemplateModel model(m_store->model());
    auto jobTemplate = std::make_shared<QCJobTemplate>();
    model.setJobTemplate(jobTemplate);
    m_recorder->clear();
    QSignalSpy loaded(&model, &QCJobTemplateModel::sgMeasurementConfigLoaded);
    QSignalSpy savable(&model, &QCJobTemplateModel::sgSetTemplateSavable);

    edit(model);

    QVERIFY(check(*jobTemplate));
    QCOMPARE(loaded.count(), 0);
    QCOMPARE(savable.count(), 0);
    QVERIFY(m_recorder->commands().empty());
}

void tst_QCJobTemplateModel::notifyEmitsOnceAndChangesNothing()
{
    QCJobTemplateModel model(m_store->model());
    auto jobTemplate = std::make_shared<QCJobTemplate>();
    model.setJobTemplate(jobTemplate);
    QSignalSpy loaded(&model, &QCJobTemplateModel::sgMeasurementConfigLoaded);
    model.notifyMeasurementConfigLoaded();
    QCOMPARE(loaded.count(), 1);
    QCOMPARE(model.jobTemplate(), jobTemplate);
}

void tst_QCJobTemplateModel::measurementConfigurationIsAnnounced_data()
{
    QTest::addColumn<std::shared_ptr<MeasurementConfiguration>>("configuration");
    QTest::newRow("a configuration") << std::make_shared<MeasurementConfiguration>();
    QTest::newRow("none removes the previous one") << std::shared_ptr<MeasurementConfiguration>();
}

void tst_QCJobTemplateModel::measurementConfigurationIsAnnounced()
{
    QFETCH(std::shared_ptr<MeasurementConfiguration>, configuration);
    QCJobTemplateModel model(m_store->model());
    auto jobTemplate = std::make_shared<QCJobTemplate>();
    jobTemplate->setMeasurementConfiguration(std::make_shared<MeasurementConfiguration>());
    model.setJobTemplate(jobTemplate);
    QSignalSpy loaded(&model, &QCJobTemplateModel::sgMeasurementConfigLoaded);
    QSignalSpy savable(&model, &QCJobTemplateModel::sgSetTemplateSavable);

    model.setMeasurementConfiguration(configuration);

    QCOMPARE(model.measurementConfiguration(), configuration);
    QCOMPARE(jobTemplate->measurementConfiguration(), configuration);
    QCOMPARE(loaded.count(), 1);
    QCOMPARE(savable.count(), 0);
}

void tst_QCJobTemplateModel::editedTemplateSurvivesTheStore()
{
    TempStore store;
    QCJobTemplateModel model(store.model());
    auto jobTemplate = std::make_shared<QCJobTemplate>();
    model.setJobTemplate(jobTemplate);
    for (const char* name : {"P0", "P1", "P2", "P3"})
        model.addCheckPoint(name);
    model.coupleCheckPoints(0, 2, "A");
    model.swapCoupledCheckPoints(0);
    QImage area(40, 30, QImage::Format_RGB32);
    area.fill(qRgb(180, 20, 60));
    QVERIFY(model.setCheckPointImage(2, QPixmap::fromImage(area), QRect(120, 85, 40, 30)));
    const QString schematicPath = store.folder() + "/part.rev.JPG";
    QFile schematic(schematicPath);
    QVERIFY(schematic.open(QIODevice::WriteOnly) && schematic.write(QByteArray(300, 'S')) == 300);
    schematic.close();
    QVERIFY(model.loadSchematicImage("part.rev.JPG", schematicPath));
    QCOMPARE(checkListText(*jobTemplate), QStringLiteral("A[P2<CP1> P0<CP2>], P1, P3"));

    QVERIFY(store.save(jobTemplate));
    store.reopen();
    const auto stored = std::dynamic_pointer_cast<QCJobTemplate>(store.fetch(QCJobTemplate::typeId(), jobTemplate->id()));

    QVERIFY(stored);
    QCOMPARE(checkListText(*stored), checkListText(*jobTemplate));
    const auto before = jobTemplate->checkPoints();
    const auto after = stored->checkPoints();
    QCOMPARE(after.size(), before.size());
    for (size_t i = 0; i < after.size(); ++i) {
        QCOMPARE(after[i]->schematicImage()->imageData(), before[i]->schematicImage()->imageData());
        QCOMPARE(after[i]->schematicImage()->format(), before[i]->schematicImage()->format());
        QCOMPARE(after[i]->position()->x(), before[i]->position()->x());
        QCOMPARE(after[i]->position()->y(), before[i]->position()->y());
        QCOMPARE(after[i]->size()->width(), before[i]->size()->width());
        QCOMPARE(after[i]->size()->height(), before[i]->size()->height());
    }
    QCOMPARE(after[2]->position()->x(), 120);
    QCOMPARE(after[2]->schematicImage()->format(), std::string("PNG"));
    QCOMPARE(stored->schematicImage()->imageData(), std::vector<unsigned char>(300, 'S'));
    QCOMPARE(stored->schematicImage()->format(), std::string("JPG"));
    QCOMPARE(stored->schematicImage()->name(), std::string("part.rev.JPG"));
}

QC_TEST_MAIN(tst_QCJobTemplateModel)
#include "tst_qcjobtemplatemodel.moc"
