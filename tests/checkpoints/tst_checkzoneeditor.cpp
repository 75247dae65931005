#include "tests/common/TestMain.h"
#include "tests/common/CheckListText.h"
#include "tests/common/ModalAnswer.h"
#include "tests/common/TempStore.h"

#include "checkpoints/CheckPointCouplet.h"
#include "checkpoints/CheckZoneEditor.h"
#include "checkpoints/CheckZoneListItem.h"
#include "host/domain/CheckPoint.h"
#include "host/domain/CheckPointCouple.h"
#include "host/domain/MeasurementConfiguration.h"
#include "host/domain/Position.h"
#include "host/domain/QCJobTemplate.h"
#include "host/domain/SchematicImage.h"
#include "host/domain/Size.h"
#include "host/domain/Standard.h"
#include "host/domain/TagDefinition.h"
#include "model/QCJobTemplateModel.h"

#include <QBuffer>
#include <QCheckBox>
#include <QDialog>
#include <QGraphicsPixmapItem>
#include <QGraphicsView>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QtTest>

using namespace vemi;

namespace {

std::shared_ptr<CheckPoint> checkPoint(const std::string& name)
{
    auto point = std::make_shared<CheckPoint>();
    point->setName(name);
    return point;
}

std::shared_ptr<CheckPointCouple> couple(const std::string& letter, std::shared_ptr<CheckPoint> first,
                                         std::shared_ptr<CheckPoint> second)
{
    first->setMatchPoint("<CP1>");
    second->setMatchPoint("<CP2>");
    auto pair = std::make_shared<CheckPointCouple>();
    pair->setName(letter);
    pair->setCheckPoints({first, second});
    return pair;
}

std::vector<unsigned char> pngBytes(const QColor& colour)
{
    QImage image(20, 12, QImage::Format_RGB32);
    image.fill(colour);
    QByteArray bytes;
    QBuffer buffer(&bytes);
    buffer.open(QIODevice::WriteOnly);
    image.save(&buffer, "PNG");
    return std::vector<unsigned char>(bytes.begin(), bytes.end());
}

void giveArea(CheckPoint& point, std::vector<unsigned char> imageData, const QRect& rect)
{
    point.schematicImage()->setImageData(std::move(imageData));
    point.setPosition(std::make_shared<Position>(rect.x(), rect.y()));
    point.setSize(std::make_shared<Size>(rect.width(), rect.height()));
}

// Answers the next checkpoint properties dialog through its named widgets.
void answerPropertiesDialog(bool accept, const QString& name = QString(), bool skippable = false)
{
    ModalAnswer::actOnNextModal([=](QWidget* modal) {
        auto* dialog = qobject_cast<QDialog*>(modal);
        QVERIFY(dialog);
        auto* nameEdit = dialog->findChild<QLineEdit*>(QStringLiteral("checkPointName"));
        auto* skippableBox = dialog->findChild<QCheckBox*>(QStringLiteral("skippableCheckBox"));
        if (!nameEdit || !skippableBox) {
            dialog->reject();
            QFAIL("the properties dialog lacks its name editor or skippable box");
        }
        if (!accept) {
            dialog->reject();
            return;
        }
        nameEdit->setText(name);
        skippableBox->setChecked(skippable);
        dialog->accept();
    });
}

using Emission = std::tuple<int, int, QRect>;

QList<Emission> emissionsOf(const QSignalSpy& spy)
{
    QList<Emission> emissions;
    for (const QList<QVariant>& arguments : spy)
        emissions << Emission(arguments[0].toInt(), arguments[1].toInt(), arguments[2].toRect());
    return emissions;
}

} // namespace

Q_DECLARE_METATYPE(Emission)

class tst_CheckZoneEditor : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleanup();
    void nextCoupleLetter_data();
    void nextCoupleLetter();
    void decoupledLetterIsGivenAgain();
    void couplingNonNeighboursRenumbersTheRowsInBetween();
    void clickInCoupleRowPicksMember_data();
    void clickInCoupleRowPicksMember();
    void move_data();
    void move();
    void rowsDrawOnlyCheckpointsWithAnAreaImage_data();
    void rowsDrawOnlyCheckpointsWithAnAreaImage();
    void publishEmitsForEveryCheckpoint();
    void addCopiesFromThePrecedingCheckpoint_data();
    void addCopiesFromThePrecedingCheckpoint();
    void propertiesDialogAnswer_data();
    void propertiesDialogAnswer();
    void renameTakesEffectWhenEditingFinishes();
    void deleteActsOnTheClickedRowNotTheKeyboardRow();
    void swapReselectsTheCoupleRow();
    void rebuildLeavesNothingOfThePreviousTemplate();

private:
    void open(std::vector<std::shared_ptr<CheckListItem>> items);
    QListWidget* list() const;
    QPushButton* button(const char* name) const;
    CheckPointCouplet* couplet(int row) const;
    // Presses and releases on a row at height y of its row widget, with the
    // cursor there too, as the row selection reads the cursor.
    void clickRow(int row, int y = 20, Qt::KeyboardModifiers modifiers = Qt::NoModifier);
    void coupleByClicks(int rowA, int rowB);
    QString rowsText() const;

    std::unique_ptr<TempStore> m_store;
    std::shared_ptr<QCJobTemplateModel> m_model;
    std::shared_ptr<QCJobTemplate> m_template;
    std::unique_ptr<CheckZoneEditor> m_editor;
};

void tst_CheckZoneEditor::init()
{
    m_store = std::make_unique<TempStore>();
    m_model = std::make_shared<QCJobTemplateModel>(m_store->model());
    m_editor = std::make_unique<CheckZoneEditor>();
    m_editor->init(m_store->model(), m_model);
    m_editor->resize(479, 900);
    m_editor->show();
    QVERIFY(QTest::qWaitForWindowExposed(m_editor.get()));
}

void tst_CheckZoneEditor::cleanup()
{
    m_editor.reset();
    m_model.reset();
    m_template.reset();
    m_store.reset();
}

void tst_CheckZoneEditor::open(std::vector<std::shared_ptr<CheckListItem>> items)
{
    m_template = std::make_shared<QCJobTemplate>();
    m_template->setCheckListItems(items);
    m_template->setMeasurementConfiguration(std::make_shared<MeasurementConfiguration>());
    m_model->setJobTemplate(m_template);
    m_model->notifyMeasurementConfigLoaded();
}

QListWidget* tst_CheckZoneEditor::list() const
{
    return m_editor->findChild<QListWidget*>(QStringLiteral("checkZoneListWidget"));
}

QPushButton* tst_CheckZoneEditor::button(const char* name) const
{
    return m_editor->findChild<QPushButton*>(QLatin1String(name));
}

CheckPointCouplet* tst_CheckZoneEditor::couplet(int row) const
{
    return qobject_cast<CheckPointCouplet*>(list()->itemWidget(list()->item(row)));
}

void tst_CheckZoneEditor::clickRow(int row, int y, Qt::KeyboardModifiers modifiers)
{
    QListWidgetItem* item = list()->item(row);
    list()->scrollToItem(item);
    const QPoint at = list()->visualItemRect(item).topLeft() + QPoint(8, y);
    QCursor::setPos(list()->viewport()->mapToGlobal(at));
    QTest::mouseClick(list()->viewport(), Qt::LeftButton, modifiers, at);
}

void tst_CheckZoneEditor::coupleByClicks(int rowA, int rowB)
{
    clickRow(rowA);
    clickRow(rowB, 20, Qt::ControlModifier);
    QVERIFY(button("coupleCheckPointsButton")->isEnabled());
    QTest::mouseClick(button("coupleCheckPointsButton"), Qt::LeftButton);
}

// The rows as the user sees them: letter, then each item's shown number and name.
QString tst_CheckZoneEditor::rowsText() const
{
    QStringList rows;
    for (int row = 0; row < list()->count(); ++row) {
        const CheckPointCouplet* c = couplet(row);
        QStringList members;
        for (int part = 1; part <= (c->isCoupled() ? 2 : 1); ++part) {
            const CheckZoneListItem* item = c->item(part);
            members << QStringLiteral("%1:%2").arg(item->number() + 1).arg(item->name());
        }
        rows << c->letter() + members.join(' ');
    }
    return rows.join(QStringLiteral(", "));
}

void tst_CheckZoneEditor::nextCoupleLetter_data()
{
    QTest::addColumn<QStringList>("storedCouples");
    QTest::addColumn<QString>("expected");

    QStringList alphabet;
    for (char letter = 'A'; letter <= 'Z'; ++letter)
        alphabet << QString(QChar(letter));
    QTest::newRow("first couple") << QStringList() << "A";
    QTest::newRow("after A and B") << QStringList{"A", "B"} << "C";
    QTest::newRow("the gap of a missing B") << QStringList{"A", "C"} << "B";
    QTest::newRow("the 27th couple after Z") << alphabet << "[";
}

void tst_CheckZoneEditor::nextCoupleLetter()
{
    QFETCH(QStringList, storedCouples);
    QFETCH(QString, expected);
    std::vector<std::shared_ptr<CheckListItem>> items;
    for (const QString& letter : storedCouples)
        items.push_back(couple(letter.toStdString(), checkPoint("x"), checkPoint("y")));
    items.push_back(checkPoint("P"));
    items.push_back(checkPoint("Q"));
    open(items);
    const int last = list()->count() - 1;

    coupleByClicks(last - 1, last);

    QCOMPARE(list()->count(), storedCouples.size() + 1);
    QCOMPARE(couplet(last - 1)->letter(), expected);
    QCOMPARE(QString::fromStdString(m_template->checkListItems().back()->name()), expected);
}

void tst_CheckZoneEditor::decoupledLetterIsGivenAgain()
{
    open({checkPoint("P0"), checkPoint("P1"), checkPoint("P2"), checkPoint("P3"), checkPoint("P4"),
          checkPoint("P5"), checkPoint("P6"), checkPoint("P7")});
    coupleByClicks(0, 1);
    coupleByClicks(1, 2);
    coupleByClicks(2, 3);
    QCOMPARE(checkListText(*m_template),
             "A[P0<CP1> P1<CP2>], B[P2<CP1> P3<CP2>], C[P4<CP1> P5<CP2>], P6, P7");

    clickRow(1);
    QTest::mouseClick(button("deCoupleCheckPointsButton"), Qt::LeftButton);
    QCOMPARE(checkListText(*m_template), "A[P0<CP1> P1<CP2>], P2, P3, C[P4<CP1> P5<CP2>], P6, P7");

    coupleByClicks(4, 5);
    QCOMPARE(rowsText(), "A1:P0 2:P1, 3:P2, 4:P3, C5:P4 6:P5, B7:P6 8:P7");
}

// Regression: rows kept the numbers from before the couple, so the name,
// properties and area of the checkpoint in between went to another one.
void tst_CheckZoneEditor::couplingNonNeighboursRenumbersTheRowsInBetween()
{
    open({checkPoint("P0"), checkPoint("P1"), checkPoint("P2")});
    QSignalSpy grab(m_editor.get(), &CheckZoneEditor::sgGrabRubberBandedArea);

    coupleByClicks(0, 2);

    QCOMPARE(checkListText(*m_template), "A[P0<CP1> P2<CP2>], P1");
    QCOMPARE(rowsText(), "A1:P0 2:P2, 3:P1");
    clickRow(1);
    QTest::mouseClick(button("addImageButton"), Qt::LeftButton);
    QCOMPARE(grab.count(), 1);
    QCOMPARE(grab.at(0).at(0).toInt(), 2);
}

void tst_CheckZoneEditor::clickInCoupleRowPicksMember_data()
{
    QTest::addColumn<int>("y");
    QTest::addColumn<int>("expectedCheckPoint");

    QTest::newRow("near the top picks the first") << 10 << 1;
    QTest::newRow("at 80 still the first") << 80 << 1;
    QTest::newRow("at 81 the second") << 81 << 2;
    QTest::newRow("near the bottom the second") << 150 << 2;
}

void tst_CheckZoneEditor::clickInCoupleRowPicksMember()
{
    QFETCH(int, y);
    QFETCH(int, expectedCheckPoint);
    open({checkPoint("P0"), couple("A", checkPoint("P1"), checkPoint("P2")), checkPoint("P3")});
    QSignalSpy grab(m_editor.get(), &CheckZoneEditor::sgGrabRubberBandedArea);
    QVERIFY(list()->visualItemRect(list()->item(1)).height() >= 160);

    clickRow(0);
    clickRow(1, y);

    const CheckPointCouplet* row = couplet(1);
    QCOMPARE(row->item(1)->isSelected(), expectedCheckPoint == 1);
    QCOMPARE(row->item(2)->isSelected(), expectedCheckPoint == 2);
    QVERIFY(!couplet(0)->item(1)->isSelected());
    QVERIFY(button("swapCoupledCheckPoints")->isEnabled());
    QTest::mouseClick(button("addImageButton"), Qt::LeftButton);
    QCOMPARE(grab.count(), 1);
    QCOMPARE(grab.at(0).at(0).toInt(), expectedCheckPoint);
}

void tst_CheckZoneEditor::move_data()
{
    QTest::addColumn<int>("row");
    QTest::addColumn<QString>("buttonName");
    QTest::addColumn<QString>("expected");

    const QString unchanged = QStringLiteral("P0, A[P1<CP1> P2<CP2>], P3");
    QTest::newRow("first row up stays") << 0 << "moveCheckZoneUpButton" << unchanged;
    QTest::newRow("last row down stays") << 2 << "moveCheckZoneDownButton" << unchanged;
    QTest::newRow("couple up") << 1 << "moveCheckZoneUpButton" << "A[P1<CP1> P2<CP2>], P0, P3";
    QTest::newRow("couple down") << 1 << "moveCheckZoneDownButton" << "P0, P3, A[P1<CP1> P2<CP2>]";
    QTest::newRow("single down past a couple") << 0 << "moveCheckZoneDownButton" << "A[P1<CP1> P2<CP2>], P0, P3";
}

void tst_CheckZoneEditor::move()
{
    QFETCH(int, row);
    QFETCH(QString, buttonName);
    QFETCH(QString, expected);
    open({checkPoint("P0"), couple("A", checkPoint("P1"), checkPoint("P2")), checkPoint("P3")});
    clickRow(row);
    QSignalSpy savable(m_editor.get(), &CheckZoneEditor::sgSetTemplateSavable);
    QSignalSpy refreshed(m_editor.get(), &CheckZoneEditor::sgRefreshCheckPointLayer);
    QPushButton* move = button(qPrintable(buttonName));
    QVERIFY(move->isEnabled());

    QTest::mouseClick(move, Qt::LeftButton);

    QCOMPARE(checkListText(*m_template), expected);
    const bool up = buttonName.contains(QLatin1String("Up"));
    const bool staysPut = (row == 0 && up) || (row == 2 && !up);
    QCOMPARE(savable.count(), staysPut ? 0 : 1);
    QCOMPARE(refreshed.count(), staysPut ? 0 : 1);
    if (!staysPut) {
        // The moved row is selected again, so it can be moved on at once.
        const CheckPointCouplet* moved = couplet(row + (up ? -1 : 1));
        QVERIFY(moved->item(1)->isSelected() || (moved->item(2) && moved->item(2)->isSelected()));
        QVERIFY(button("moveCheckZoneUpButton")->isEnabled());
    }
}

void tst_CheckZoneEditor::rowsDrawOnlyCheckpointsWithAnAreaImage_data()
{
    QTest::addColumn<int>("imageBytes");
    QTest::addColumn<bool>("drawn");
    QTest::addColumn<bool>("thumbnail");

    QTest::newRow("no image") << 0 << false << false;
    QTest::newRow("10 bytes") << 10 << false << false;
    QTest::newRow("11 bytes that are no picture") << 11 << true << false;
    QTest::newRow("a PNG picture") << -1 << true << true;
}

void tst_CheckZoneEditor::rowsDrawOnlyCheckpointsWithAnAreaImage()
{
    QFETCH(int, imageBytes);
    QFETCH(bool, drawn);
    QFETCH(bool, thumbnail);
    auto first = checkPoint("P0");
    auto second = checkPoint("P1");
    const QRect area(30, 40, 20, 12);
    giveArea(*second, imageBytes < 0 ? pngBytes(Qt::red) : std::vector<unsigned char>(size_t(imageBytes), 'x'),
             area);
    QSignalSpy added(m_editor.get(), &CheckZoneEditor::sgAddCheckpointToSchematic);

    open({couple("A", first, second)});

    QCOMPARE(emissionsOf(added), drawn ? QList<Emission>{Emission(1, 1, area)} : QList<Emission>{});
    auto* view = couplet(0)->item(2)->findChild<QGraphicsView*>(QStringLiteral("checkZoneGraphicsView"));
    const auto items = view->scene()->items();
    QCOMPARE(items.size(), 1);
    const auto* pixmap = qgraphicsitem_cast<QGraphicsPixmapItem*>(items.first());
    QCOMPARE(pixmap->pixmap().isNull(), !thumbnail);
    if (thumbnail)
        QCOMPARE(pixmap->pixmap().size(), QSize(20, 12));
}

void tst_CheckZoneEditor::publishEmitsForEveryCheckpoint()
{
    auto withArea = checkPoint("P3");
    giveArea(*withArea, pngBytes(Qt::blue), QRect(5, 6, 7, 8));
    auto tiny = checkPoint("P4");
    giveArea(*tiny, std::vector<unsigned char>(10, 'x'), QRect(1, 2, 3, 4));
    open({checkPoint("P0"), couple("A", checkPoint("P1"), checkPoint("P2")), withArea,
          couple("B", tiny, checkPoint("P5"))});
    QSignalSpy added(m_editor.get(), &CheckZoneEditor::sgAddCheckpointToSchematic);

    m_editor->publishCheckPoints();

    const QList<Emission> expected{Emission(0, 0, QRect()), Emission(1, 1, QRect()), Emission(2, 1, QRect()),
                                   Emission(3, 0, QRect(5, 6, 7, 8)), Emission(4, 2, QRect(1, 2, 3, 4)),
                                   Emission(5, 2, QRect())};
    QCOMPARE(emissionsOf(added), expected);
}

void tst_CheckZoneEditor::addCopiesFromThePrecedingCheckpoint_data()
{
    QTest::addColumn<bool>("coupleLast");
    QTest::addColumn<bool>("templateHasStandard");

    QTest::newRow("after a single checkpoint, with a couple before it") << false << false;
    QTest::newRow("after the second member of a couple") << true << false;
    // The dialog then lists the standard: a copied choice must show as chosen,
    // not as "Auto Select", or OK would drop it.
    QTest::newRow("standard listed by the template") << false << true;
}

// Regression: settings were taken from the checkpoint numbered like the
// previous row, which is a different one once a couple comes before.
void tst_CheckZoneEditor::addCopiesFromThePrecedingCheckpoint()
{
    QFETCH(bool, coupleLast);
    QFETCH(bool, templateHasStandard);
    auto lender = checkPoint("Lender");
    auto standard = std::make_shared<Standard>();
    standard->setName("Red");
    lender->setStandard(standard);
    lender->setAutoStandard(false);
    lender->setSkippable(true);
    auto definition = std::make_shared<TagDefinition>();
    definition->setName("Paint");
    lender->setTagDefinitions({definition});
    auto other = checkPoint("Other");
    if (coupleLast)
        open({checkPoint("P0"), couple("A", other, lender)});
    else
        open({couple("A", checkPoint("P0"), other), lender});
    if (templateHasStandard)
        m_template->setStandards({standard});

    answerPropertiesDialog(true, "Door", true);
    QTest::mouseClick(button("addCheckZoneButton"), Qt::LeftButton);

    QCOMPARE(m_model->checkPointCount(), 4);
    const auto added = m_model->checkPointAt(3);
    QCOMPARE(added->name(), std::string("Door"));
    QCOMPARE(added->standard(), standard);
    QVERIFY(!added->autoStandard());
    QVERIFY(added->skippable());
    QCOMPARE(added->tagDefinitions().size(), size_t(1));
    QCOMPARE(added->tagDefinitions().front(), definition);
}

void tst_CheckZoneEditor::propertiesDialogAnswer_data()
{
    QTest::addColumn<bool>("accept");
    QTest::addColumn<QString>("expectedName");
    QTest::addColumn<int>("editorSavable");

    QTest::newRow("cancel keeps New Checkpoint") << false << "New Checkpoint" << 0;
    QTest::newRow("OK takes the name") << true << "Hinge" << 1;
}

void tst_CheckZoneEditor::propertiesDialogAnswer()
{
    QFETCH(bool, accept);
    QFETCH(QString, expectedName);
    QFETCH(int, editorSavable);
    open({checkPoint("P0")});
    QSignalSpy savable(m_editor.get(), &CheckZoneEditor::sgSetTemplateSavable);

    answerPropertiesDialog(accept, "Hinge", true);
    QTest::mouseClick(button("addCheckZoneButton"), Qt::LeftButton);

    QCOMPARE(checkListText(*m_template), "P0, " + expectedName);
    QCOMPARE(couplet(1)->item(1)->name(), expectedName);
    QCOMPARE(m_model->checkPointAt(1)->skippable(), accept);
    QCOMPARE(savable.count(), editorSavable);
    QVERIFY(couplet(1)->item(1)->isSelected());
    QVERIFY(button("checkZonePropertiesButton")->isEnabled());
}

void tst_CheckZoneEditor::renameTakesEffectWhenEditingFinishes()
{
    open({checkPoint("P0"), checkPoint("P1")});
    QSignalSpy savable(m_model.get(), &QCJobTemplateModel::sgSetTemplateSavable);
    auto* nameEdit = couplet(1)->item(1)->findChild<QLineEdit*>(QStringLiteral("checkZoneNameLineEdit"));

    nameEdit->selectAll();
    QTest::keyClicks(nameEdit, QStringLiteral("Rim"));
    QCOMPARE(nameEdit->text(), QStringLiteral("Rim"));
    QCOMPARE(checkListText(*m_template), QStringLiteral("P0, P1"));
    QCOMPARE(savable.count(), 0);

    QTest::keyClick(nameEdit, Qt::Key_Return);
    QCOMPARE(checkListText(*m_template), QStringLiteral("P0, Rim"));
    QCOMPARE(savable.count(), 1);

    // Editing finishes again when the field loses focus; the name did not change.
    QTest::keyClick(nameEdit, Qt::Key_Return);
    QCOMPARE(savable.count(), 1);
}

// Regression: delete removed the list's keyboard-current row from the
// template while the editor deleted the clicked row.
void tst_CheckZoneEditor::deleteActsOnTheClickedRowNotTheKeyboardRow()
{
    open({checkPoint("P0"), couple("A", checkPoint("P1"), checkPoint("P2")), checkPoint("P3")});
    clickRow(2);
    list()->setCurrentRow(0);
    QSignalSpy refreshed(m_editor.get(), &CheckZoneEditor::sgRefreshCheckPointLayer);

    QTest::mouseClick(button("deleteCheckZoneButton"), Qt::LeftButton);

    QCOMPARE(checkListText(*m_template), "P0, A[P1<CP1> P2<CP2>]");
    QCOMPARE(rowsText(), "1:P0, A2:P1 3:P2");
    QCOMPARE(refreshed.count(), 1);
    QVERIFY(!button("deleteCheckZoneButton")->isEnabled());
}

void tst_CheckZoneEditor::swapReselectsTheCoupleRow()
{
    open({checkPoint("P0"), couple("A", checkPoint("P1"), checkPoint("P2")), checkPoint("P3")});
    clickRow(1);

    QTest::mouseClick(button("swapCoupledCheckPoints"), Qt::LeftButton);

    QCOMPARE(checkListText(*m_template), "P0, A[P2<CP1> P1<CP2>], P3");
    QCOMPARE(rowsText(), "1:P0, A2:P2 3:P1, 4:P3");
    QVERIFY(button("swapCoupledCheckPoints")->isEnabled());
    QVERIFY(button("deCoupleCheckPointsButton")->isEnabled());
}

void tst_CheckZoneEditor::rebuildLeavesNothingOfThePreviousTemplate()
{
    open({couple("A", checkPoint("P0"), checkPoint("P1")), checkPoint("P2"), checkPoint("P3")});
    coupleByClicks(1, 2);
    QCOMPARE(rowsText(), "A1:P0 2:P1, B3:P2 4:P3");

    open({checkPoint("Q0"), checkPoint("Q1")});
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);

    QCOMPARE(rowsText(), "1:Q0, 2:Q1");
    QCOMPARE(m_editor->findChildren<CheckPointCouplet*>().size(), 2);
    QVERIFY(list()->selectedItems().isEmpty());
    for (const char* name : {"deleteCheckZoneButton", "coupleCheckPointsButton", "deCoupleCheckPointsButton",
                             "swapCoupledCheckPoints", "checkZonePropertiesButton", "addImageButton"})
        QVERIFY2(!button(name)->isEnabled(), name);
    coupleByClicks(0, 1);
    QCOMPARE(checkListText(*m_template), "A[Q0<CP1> Q1<CP2>]");
}

QC_TEST_MAIN(tst_CheckZoneEditor)
#include "tst_checkzoneeditor.moc"
