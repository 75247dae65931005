#include "tests/common/TestMain.h"

#include "host/domain/TagDefinition.h"
#include "host/domain/TagValue.h"
#include "host/widgets/TagDisplayWidget.h"

#include <QTableWidget>

#include <memory>

using vemi::TagDefinition;
using vemi::TagDisplayWidget;
using vemi::TagValue;

namespace {

using Definitions = std::vector<std::shared_ptr<TagDefinition>>;
using Values = std::vector<std::shared_ptr<TagValue>>;

std::shared_ptr<TagDefinition> definition(const std::string& name, const std::string& defaultValue = {})
{
    auto result = std::make_shared<TagDefinition>();
    result->setName(name);
    result->setDefaultValue(defaultValue);
    return result;
}

// Four definitions: "Supplier" (no default), "Batch" (default "B-1"),
// "Material", "Größe" (default "M").
Definitions fourDefinitions()
{
    return {definition("Supplier"), definition("Batch", "B-1"), definition("Material"), definition("Größe", "M")};
}

} // namespace

class tst_TagDisplayWidget : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void cleanup();
    void showsOneRowPerDefinition_data();
    void showsOneRowPerDefinition();
    void clicksSelectAndReport_data();
    void clicksSelectAndReport();
    void setTagsReplacesEveryRow();

private:
    QTableWidget* table() const { return m_widget->findChild<QTableWidget*>(QStringLiteral("tagTable")); }
    QPoint rowCentre(int row) const;
    void clickRow(int row, Qt::KeyboardModifiers modifiers = Qt::NoModifier);
    void doubleClickRow(int row);

    std::unique_ptr<TagDisplayWidget> m_widget;
    Definitions m_definitions;
};

void tst_TagDisplayWidget::init()
{
    m_widget = std::make_unique<TagDisplayWidget>();
    m_widget->resize(400, 300);
    m_definitions = fourDefinitions();
    m_widget->setTags({}, m_definitions);
    m_widget->show();
    QVERIFY(QTest::qWaitForWindowExposed(m_widget.get()));
    QVERIFY(table());
}

void tst_TagDisplayWidget::cleanup()
{
    m_widget.reset();
}

QPoint tst_TagDisplayWidget::rowCentre(int row) const
{
    return table()->visualItemRect(table()->item(row, 0)).center();
}

void tst_TagDisplayWidget::clickRow(int row, Qt::KeyboardModifiers modifiers)
{
    QTest::mouseClick(table()->viewport(), Qt::LeftButton, modifiers, rowCentre(row));
}

// QTest's double-click event comes without the press that a real one follows.
void tst_TagDisplayWidget::doubleClickRow(int row)
{
    clickRow(row);
    QTest::mouseDClick(table()->viewport(), Qt::LeftButton, Qt::NoModifier, rowCentre(row));
}

void tst_TagDisplayWidget::showsOneRowPerDefinition_data()
{
    QTest::addColumn<QList<int>>("valueOf");   // definition index per value, in the values' order
    QTest::addColumn<QStringList>("texts");
    QTest::addColumn<QStringList>("expected"); // value column, row by row

    QTest::newRow("no values: defaults or blank") << QList<int>{} << QStringList{}
                                                  << QStringList{"", "B-1", "", "M"};
    QTest::newRow("a value wins over the default") << QList<int>{1} << QStringList{"B-7"}
                                                   << QStringList{"", "B-7", "", "M"};
    QTest::newRow("values in another order than the definitions")
        << QList<int>{3, 0} << QStringList{"XL", "Acme"} << QStringList{"Acme", "B-1", "", "XL"};
    QTest::newRow("fewer values than definitions, not at the same positions")
        << QList<int>{2} << QStringList{"Steel"} << QStringList{"", "B-1", "Steel", "M"};
    QTest::newRow("a blank value hides the default") << QList<int>{3} << QStringList{""}
                                                     << QStringList{"", "B-1", "", ""};
    QTest::newRow("a value of an unknown definition shows nowhere")
        << QList<int>{-1, 0} << QStringList{"lost", "Acme"} << QStringList{"Acme", "B-1", "", "M"};
}

void tst_TagDisplayWidget::showsOneRowPerDefinition()
{
    QFETCH(QList<int>, valueOf);
    QFETCH(QStringList, texts);
    QFETCH(QStringList, expected);

    TagDefinition stranger;
    Values values;
    for (int i = 0; i < valueOf.size(); ++i) {
        const TagDefinition& owner = valueOf[i] < 0 ? stranger : *m_definitions[size_t(valueOf[i])];
        values.push_back(TagValue::forDefinition(owner, texts[i].toStdString()));
    }
    m_widget->setTags(values, m_definitions);

    QCOMPARE(table()->rowCount(), int(m_definitions.size()));
    QStringList shown;
    for (int row = 0; row < table()->rowCount(); ++row) {
        QCOMPARE(table()->item(row, 0)->text(), QString::fromStdString(m_definitions[size_t(row)]->name()));
        shown << table()->item(row, 1)->text();
    }
    QCOMPARE(shown, expected);
}

void tst_TagDisplayWidget::clicksSelectAndReport_data()
{
    QTest::addColumn<QStringList>("clicks"); // row numbers, "^" for a Ctrl-click, "below" under the last row
    QTest::addColumn<QList<int>>("selected");
    QTest::addColumn<int>("reportedRow");     // of the last report; -1: none
    QTest::addColumn<QStringList>("reportedNames");

    QTest::newRow("click selects the row") << QStringList{"2"} << QList<int>{2} << 2 << QStringList{"Material"};
    QTest::newRow("ctrl-click adds rows, reported in row order")
        << QStringList{"3", "^0"} << QList<int>{0, 3} << 0 << QStringList{"Supplier", "Größe"};
    QTest::newRow("ctrl-click on a selected row takes it out")
        << QStringList{"3", "^0", "^3"} << QList<int>{0} << 0 << QStringList{"Supplier"};
    QTest::newRow("click below the rows reports no row") << QStringList{"1", "below"} << QList<int>{} << -1
                                                         << QStringList{};
}

void tst_TagDisplayWidget::clicksSelectAndReport()
{
    QFETCH(QStringList, clicks);
    QFETCH(QList<int>, selected);
    QFETCH(int, reportedRow);
    QFETCH(QStringList, reportedNames);
    QSignalSpy reported(m_widget.get(), &TagDisplayWidget::tagRowsSelected);

    for (const QString& click : clicks) {
        if (click == "below")
            QTest::mouseClick(table()->viewport(), Qt::LeftButton, Qt::NoModifier,
                              QPoint(10, table()->visualItemRect(table()->item(3, 0)).bottom() + 20));
        else
            clickRow(click.right(1).toInt(), click.startsWith('^') ? Qt::ControlModifier : Qt::NoModifier);
    }

    QCOMPARE(m_widget->getSelectedRows(), std::vector<int>(selected.begin(), selected.end()));
    QVERIFY(!reported.isEmpty());
    QCOMPARE(qMax(reported.last().at(0).toInt(), -1), reportedRow);
    QCOMPARE(reported.last().at(1).toStringList(), reportedNames);
}

void tst_TagDisplayWidget::setTagsReplacesEveryRow()
{
    QSignalSpy doubleClicked(m_widget.get(), &TagDisplayWidget::tagRowDoubleClicked);
    doubleClickRow(3);
    QCOMPARE(doubleClicked.count(), 1);
    QCOMPARE(doubleClicked.first().at(0).toInt(), 3);
    QCOMPARE(doubleClicked.first().at(1).value<std::string>(), std::string("Größe"));

    m_widget->setTags({}, {definition("Only")});

    QCOMPARE(table()->rowCount(), 1);
    QCOMPARE(table()->item(0, 0)->text(), QStringLiteral("Only"));
    QVERIFY(m_widget->getSelectedRows().empty());

    // A double-click on the new row names the new definition, not the old row's.
    doubleClickRow(0);
    QCOMPARE(doubleClicked.count(), 2);
    QCOMPARE(doubleClicked.last().at(0).toInt(), 0);
    QCOMPARE(doubleClicked.last().at(1).value<std::string>(), std::string("Only"));
}

QC_TEST_MAIN(tst_TagDisplayWidget)
#include "tst_tagdisplaywidget.moc"
