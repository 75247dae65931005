#include "tests/common/TestMain.h"
#include "tests/common/CheckListText.h"
#include "tests/common/TempStore.h"

#include "host/domain/CheckPoint.h"
#include "host/domain/CheckPointCouple.h"
#include "host/domain/Position.h"
#include "host/domain/QCJobTemplate.h"
#include "model/QCJobTemplateModel.h"
#include "host/domain/SchematicImage.h"
#include "host/domain/Size.h"

#include <QtTest>

#include <functional>
#include <stdexcept>

using namespace vemi;

using Edit = std::function<void(QCJobTemplateModel&)>;
Q_DECLARE_METATYPE(Edit)

namespace {

const QString fourSingles = QStringLiteral("P0, P1, P2, P3");

Edit noEdit()
{
    return [](QCJobTemplateModel&) {};
}

Edit coupling(int first, int second, const char* name)
{
    return [=](QCJobTemplateModel& m) { m.coupleCheckPoints(first, second, name); };
}

} // namespace

// Every test starts from the check list P0, P1, P2, P3 of single checkpoints.
class tst_CheckList : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleanup();
    void edit_data();
    void edit();
    void couple_data();
    void couple();
    void addingToAnEmptyListCountsFromZero();
    void couplesCountTwiceInCheckpointOrder();
    void checkpointIndexOutOfRangeThrows_data();
    void checkpointIndexOutOfRangeThrows();
    void swappingMembersReplacesTheCouple();

private:
    std::unique_ptr<TempStore> m_store;
    std::unique_ptr<QCJobTemplateModel> m_model;
    std::shared_ptr<QCJobTemplate> m_template;
};

void tst_CheckList::init()
{
    m_store = std::make_unique<TempStore>();
    m_model = std::make_unique<QCJobTemplateModel>(m_store->model());
    m_template = std::make_shared<QCJobTemplate>();
    m_model->setJobTemplate(m_template);
    for (const char* name : {"P0", "P1", "P2", "P3"})
        m_model->addCheckPoint(name);
    QCOMPARE(checkListText(*m_template), fourSingles);
}

void tst_CheckList::cleanup()
{
    m_model.reset();
    m_template.reset();
    m_store.reset();
}

void tst_CheckList::edit_data()
{
    QTest::addColumn<Edit>("arrange");
    QTest::addColumn<Edit>("edit");
    QTest::addColumn<QString>("expected");
    QTest::addColumn<int>("savableSignals");

    const auto none = noEdit();
    const auto coupleFirstAndThird = coupling(0, 2, "A");

    QTest::newRow("add appends at the end")
        << none << Edit([](QCJobTemplateModel& m) { m.addCheckPoint("New"); }) << "P0, P1, P2, P3, New" << 1;
    QTest::newRow("rename a single checkpoint")
        << none << Edit([](QCJobTemplateModel& m) { m.renameCheckPoint(1, "Rim"); }) << "P0, Rim, P2, P3" << 1;
    QTest::newRow("rename the second member of a couple by its checkpoint index")
        << coupleFirstAndThird << Edit([](QCJobTemplateModel& m) { m.renameCheckPoint(1, "Rim"); })
        << "A[P0<CP1> Rim<CP2>], P1, P3" << 1;

    QTest::newRow("remove a single item")
        << none << Edit([](QCJobTemplateModel& m) { m.removeCheckListItem(1); }) << "P0, P2, P3" << 1;
    QTest::newRow("remove a couple with both members")
        << coupleFirstAndThird << Edit([](QCJobTemplateModel& m) { m.removeCheckListItem(0); }) << "P1, P3" << 1;
    QTest::newRow("remove past the end changes nothing")
        << none << Edit([](QCJobTemplateModel& m) { m.removeCheckListItem(4); }) << fourSingles << 0;
    QTest::newRow("remove at a negative index changes nothing")
        << none << Edit([](QCJobTemplateModel& m) { m.removeCheckListItem(-1); }) << fourSingles << 0;

    QTest::newRow("swap items emits nothing")
        << none << Edit([](QCJobTemplateModel& m) { m.swapCheckListItems(0, 3); }) << "P3, P1, P2, P0" << 0;
    QTest::newRow("swap a couple with a single item")
        << coupleFirstAndThird << Edit([](QCJobTemplateModel& m) { m.swapCheckListItems(0, 2); })
        << "P3, P1, A[P0<CP1> P2<CP2>]" << 0;
    QTest::newRow("swap with an item past the end changes nothing")
        << none << Edit([](QCJobTemplateModel& m) { m.swapCheckListItems(0, 4); }) << fourSingles << 0;
    QTest::newRow("swap with a negative index changes nothing")
        << none << Edit([](QCJobTemplateModel& m) { m.swapCheckListItems(-1, 2); }) << fourSingles << 0;

    QTest::newRow("decouple puts the members where the couple stood")
        << coupleFirstAndThird << Edit([](QCJobTemplateModel& m) { m.decoupleCheckPoints(0); })
        << "P0, P2, P1, P3" << 1;
    QTest::newRow("decouple a single checkpoint changes nothing")
        << none << Edit([](QCJobTemplateModel& m) { m.decoupleCheckPoints(1); }) << fourSingles << 0;
    QTest::newRow("decouple past the end changes nothing")
        << coupleFirstAndThird << Edit([](QCJobTemplateModel& m) { m.decoupleCheckPoints(3); })
        << "A[P0<CP1> P2<CP2>], P1, P3" << 0;
    QTest::newRow("decouple at a negative index changes nothing")
        << coupleFirstAndThird << Edit([](QCJobTemplateModel& m) { m.decoupleCheckPoints(-1); })
        << "A[P0<CP1> P2<CP2>], P1, P3" << 0;

    QTest::newRow("swap members exchanges their match points")
        << coupling(1, 3, "B") << Edit([](QCJobTemplateModel& m) { m.swapCoupledCheckPoints(1); })
        << "P0, B[P3<CP1> P1<CP2>], P2" << 1;
    QTest::newRow("swap members of a single checkpoint changes nothing")
        << none << Edit([](QCJobTemplateModel& m) { m.swapCoupledCheckPoints(0); }) << fourSingles << 0;
    QTest::newRow("swap members past the end changes nothing")
        << coupleFirstAndThird << Edit([](QCJobTemplateModel& m) { m.swapCoupledCheckPoints(3); })
        << "A[P0<CP1> P2<CP2>], P1, P3" << 0;

    QTest::newRow("couple, swap and decouple leave the members swapped and unmarked")
        << none << Edit([](QCJobTemplateModel& m) {
               m.coupleCheckPoints(0, 2, "A");
               m.swapCoupledCheckPoints(0);
               m.decoupleCheckPoints(0);
           })
        << "P2, P0, P1, P3" << 5;
}

void tst_CheckList::edit()
{
    QFETCH(Edit, arrange);
    QFETCH(Edit, edit);
    QFETCH(QString, expected);
    QFETCH(int, savableSignals);
    arrange(*m_model);
    QSignalSpy savable(m_model.get(), &QCJobTemplateModel::sgSetTemplateSavable);
    QSignalSpy loaded(m_model.get(), &QCJobTemplateModel::sgMeasurementConfigLoaded);

    edit(*m_model);

    QCOMPARE(checkListText(*m_template), expected);
    QCOMPARE(savable.count(), savableSignals);
    QCOMPARE(loaded.count(), 0);
}

void tst_CheckList::couple_data()
{
    QTest::addColumn<Edit>("arrange");
    QTest::addColumn<int>("first");
    QTest::addColumn<int>("second");
    QTest::addColumn<int>("result");
    QTest::addColumn<QString>("expected");

    const auto none = noEdit();
    QTest::newRow("first and last") << none << 0 << 3 << 0 << "A[P0<CP1> P3<CP2>], P1, P2";
    QTest::newRow("neighbours in the middle") << none << 1 << 2 << 1 << "P0, A[P1<CP1> P2<CP2>], P3";
    QTest::newRow("higher index first stands where the first stood")
        << none << 2 << 0 << 2 << "P1, A[P2<CP1> P0<CP2>], P3";
    QTest::newRow("second index past the end") << none << 0 << 4 << -1 << fourSingles;
    QTest::newRow("negative index") << none << -1 << 2 << -1 << fourSingles;
    QTest::newRow("same checkpoint twice") << none << 1 << 1 << -1 << fourSingles;
    QTest::newRow("a member of a couple")
        << coupling(0, 1, "B") << 1 << 2 << -1 << "B[P0<CP1> P1<CP2>], P2, P3";
}

void tst_CheckList::couple()
{
    QFETCH(Edit, arrange);
    QFETCH(int, first);
    QFETCH(int, second);
    QFETCH(int, result);
    QFETCH(QString, expected);
    arrange(*m_model);
    QSignalSpy savable(m_model.get(), &QCJobTemplateModel::sgSetTemplateSavable);

    QCOMPARE(m_model->coupleCheckPoints(first, second, "A"), result);

    QCOMPARE(checkListText(*m_template), expected);
    QCOMPARE(savable.count(), result < 0 ? 0 : 3);
    QCOMPARE(m_model->checkPointCount(), 4);
}

void tst_CheckList::addingToAnEmptyListCountsFromZero()
{
    auto empty = std::make_shared<QCJobTemplate>();
    m_model->setJobTemplate(empty);
    QCOMPARE(m_model->checkPointCount(), 0);

    const auto first = m_model->addCheckPoint("Grün ✓");
    const auto second = m_model->addCheckPoint("New Checkpoint");

    QCOMPARE(first->name(), std::string("Grün ✓"));
    QCOMPARE(m_model->checkZoneIndex(first), 0);
    QCOMPARE(m_model->checkZoneIndex(second), 1);
    QVERIFY(first->position() && first->size() && first->schematicImage());
    QVERIFY(first->position() != second->position());
    QVERIFY(first->schematicImage() != second->schematicImage());
    QVERIFY(first->schematicImage()->imageData().empty());
}

void tst_CheckList::couplesCountTwiceInCheckpointOrder()
{
    m_model->coupleCheckPoints(1, 3, "A");
    QCOMPARE(checkListText(*m_template), QStringLiteral("P0, A[P1<CP1> P3<CP2>], P2"));

    QCOMPARE(m_model->checkPointCount(), 4);
    const QStringList expectedOrder{"P0", "P1", "P3", "P2"};
    for (int index = 0; index < 4; ++index) {
        const auto checkPoint = m_model->checkPointAt(index);
        QCOMPARE(QString::fromStdString(checkPoint->name()), expectedOrder[index]);
        QCOMPARE(m_model->checkZoneIndex(checkPoint), index);
    }
    QCOMPARE(m_model->checkZoneIndex(std::make_shared<CheckPoint>()), -1);
}

void tst_CheckList::checkpointIndexOutOfRangeThrows_data()
{
    QTest::addColumn<Edit>("edit");
    QTest::newRow("read past the end") << Edit([](QCJobTemplateModel& m) { m.checkPointAt(4); });
    QTest::newRow("read at a negative index") << Edit([](QCJobTemplateModel& m) { m.checkPointAt(-1); });
    QTest::newRow("rename past the end") << Edit([](QCJobTemplateModel& m) { m.renameCheckPoint(4, "X"); });
    QTest::newRow("rename at a negative index") << Edit([](QCJobTemplateModel& m) { m.renameCheckPoint(-1, "X"); });
    QTest::newRow("cut-out past the end")
        << Edit([](QCJobTemplateModel& m) { m.setCheckPointImage(4, QPixmap(4, 4), QRect(0, 0, 4, 4)); });
}

void tst_CheckList::checkpointIndexOutOfRangeThrows()
{
    QFETCH(Edit, edit);
    QSignalSpy savable(m_model.get(), &QCJobTemplateModel::sgSetTemplateSavable);
    try {
        edit(*m_model);
        QFAIL("no exception");
    } catch (const std::out_of_range& error) {
        QCOMPARE(QString(error.what()), QStringLiteral("invalid vector<T> subscript"));
    }
    QCOMPARE(checkListText(*m_template), fourSingles);
    QCOMPARE(savable.count(), 0);
}

void tst_CheckList::swappingMembersReplacesTheCouple()
{
    m_model->coupleCheckPoints(0, 2, "A");
    const auto before = m_template->checkListItems().front();

    m_model->swapCoupledCheckPoints(0);

    const auto after = std::dynamic_pointer_cast<CheckPointCouple>(m_template->checkListItems().front());
    QVERIFY(after);
    QVERIFY(after != before);
    QCOMPARE(after->name(), std::string("A"));
}

QC_TEST_MAIN(tst_CheckList)
#include "tst_checklist.moc"
