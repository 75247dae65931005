#include "RecordingDispatcher.h"
#include "TempStore.h"

#include "ColorStandardsLibrary.h"
#include "GetMarloObjects.h"
#include "QCJobTemplate.h"
#include "QCJobTemplateModel.h"
#include "TagDefinition.h"
#include "TagValue.h"
#include "UpdateObject.h"

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

QTEST_GUILESS_MAIN(tst_QCJobTemplateModel)
#include "tst_qcjobtemplatemodel.moc"
