#include "tests/common/ModalAnswer.h"
#include "tests/common/TempStore.h"
#include "tests/common/TestMain.h"

#include "host/domain/TagDefinition.h"
#include "host/domain/TagValue.h"
#include "host/widgets/TagDefinitionDialog.h"
#include "host/widgets/TagValueEdit.h"

#include <QComboBox>
#include <QDialogButtonBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

using vemi::TagDefinition;
using vemi::TagDefinitionDialog;
using vemi::TagValue;
using vemi::TagValueEdit;

namespace {

using Values = std::vector<std::shared_ptr<TagValue>>;

std::shared_ptr<TagDefinition> definition(const QString& kind, const std::string& name = "Batch")
{
    auto result = std::make_shared<TagDefinition>();
    result->setName(name);
    result->setDefaultValue("7");
    if (kind == "number")
        result->setValueKind(TagDefinition::ValueKind::Number);
    if (kind == "choice")
        result->setAllowedValues({"7", "matt", "glänzend"});
    return result;
}

QStringList texts(const Values& values)
{
    QStringList result;
    for (const auto& value : values)
        result << QString::fromStdString(value->value());
    return result;
}

} // namespace

class tst_TagDefinitionDialog : public QObject
{
    Q_OBJECT

private slots:
    void rejection_data();
    void rejection();
    void write_data();
    void write();
    void writeLeavesTheOldValueObjectAlone();

    void cancelChangesNothing();
    void refusedThenAcceptedValue();
    void choiceOffersTheAllowedValues();

private:
    TempStore m_store;
};

void tst_TagDefinitionDialog::rejection_data()
{
    QTest::addColumn<QString>("kind");
    QTest::addColumn<QString>("text");
    QTest::addColumn<bool>("accepted");

    QTest::newRow("free text takes anything") << "text" << "Größe 3/4 \"x\"" << true;
    QTest::newRow("a number takes a decimal number") << "number" << "12.5" << true;
    QTest::newRow("a number takes a negative exponent") << "number" << "-1e-3" << true;
    QTest::newRow("a number takes surrounding blanks") << "number" << " 4 " << true;
    QTest::newRow("a number refuses words") << "number" << "twelve" << false;
    QTest::newRow("a number refuses a trailing unit") << "number" << "12 mm" << false;
    QTest::newRow("a choice takes a listed value") << "choice" << "glänzend" << true;
    QTest::newRow("a choice refuses a value differing in case") << "choice" << "Matt" << false;
    QTest::newRow("a choice refuses an unlisted value") << "choice" << "rough" << false;
    QTest::newRow("blank is allowed for a number") << "number" << "" << true;
    QTest::newRow("blank is allowed for a choice") << "choice" << "  " << true;
}

void tst_TagDefinitionDialog::rejection()
{
    QFETCH(QString, kind);
    QFETCH(QString, text);
    QFETCH(bool, accepted);

    const QString why = TagValueEdit::rejection(*definition(kind), text);
    QCOMPARE(why.isEmpty(), accepted);
    if (!accepted)
        QVERIFY2(why.contains("Batch") && why.contains(text), qPrintable(why));
}

void tst_TagDefinitionDialog::write_data()
{
    // Values of the definition under edit ("mine") and of others ("other"),
    // in list order; each entry "owner=text".
    QTest::addColumn<QStringList>("before");
    QTest::addColumn<QString>("text");
    QTest::addColumn<bool>("changed");
    QTest::addColumn<QStringList>("after");

    QTest::newRow("replaces its value in place")
        << QStringList{"other=a", "mine=1", "other=b"} << "2" << true << QStringList{"a", "2", "b"};
    QTest::newRow("appends a value when it had none")
        << QStringList{"other=a"} << "2" << true << QStringList{"a", "2"};
    QTest::newRow("appends to an empty list") << QStringList{} << "2" << true << QStringList{"2"};
    QTest::newRow("same value is no change") << QStringList{"mine=1", "other=a"} << "1" << false
                                             << QStringList{"1", "a"};
    QTest::newRow("the default without a value is no change") << QStringList{"other=a"} << "7" << false
                                                               << QStringList{"a"};
    QTest::newRow("the default over another value is a change") << QStringList{"mine=1"} << "7" << true
                                                                << QStringList{"7"};
    QTest::newRow("blank over the default is a change") << QStringList{} << "" << true << QStringList{""};
}

void tst_TagDefinitionDialog::write()
{
    QFETCH(QStringList, before);
    QFETCH(QString, text);
    QFETCH(bool, changed);
    QFETCH(QStringList, after);

    const auto mine = definition("text");
    const auto other = definition("text", "Supplier");
    Values values;
    for (const QString& entry : before)
        values.push_back(TagValue::forDefinition(entry.startsWith("mine") ? *mine : *other,
                                                 entry.section('=', 1).toStdString()));
    const Values original = values;

    QCOMPARE(TagValueEdit::write(values, *mine, text.toStdString()), changed);
    QCOMPARE(texts(values), after);
    if (!changed)
        QVERIFY(values == original);
    // Either way the definition now shows the text.
    QCOMPARE(QString::fromStdString(TagValueEdit::shownValue(values, *mine)), text);
    for (size_t i = 0; i < original.size() && i < values.size(); ++i) {
        if (original[i]->definitionId() == other->id())
            QVERIFY2(values[i] == original[i], "a value of another definition was touched");
    }
}

void tst_TagDefinitionDialog::writeLeavesTheOldValueObjectAlone()
{
    // The list is a copy of an object's values that shares their objects;
    // writing must not change the object before its caller stores the list.
    const auto mine = definition("text");
    const auto old = TagValue::forDefinition(*mine, "1");
    Values values{old};

    QVERIFY(TagValueEdit::write(values, *mine, "2"));

    QCOMPARE(old->value(), std::string("1"));
    QCOMPARE(values[0]->value(), std::string("2"));
    QCOMPARE(values[0]->id(), old->id());
}

void tst_TagDefinitionDialog::cancelChangesNothing()
{
    const auto mine = definition("text");
    Values values;
    ModalAnswer::actOnNextModal([](QWidget* dialog) {
        QTest::keyClicks(dialog->findChild<QLineEdit*>("valueEdit"), "typed, then cancelled");
        dialog->findChild<QDialogButtonBox*>("buttonBox")->button(QDialogButtonBox::Cancel)->click();
    });

    TagDefinitionDialog dialog;
    QVERIFY(!dialog.edit(m_store.model(), values, mine));
    QVERIFY(values.empty());
}

// A refused value keeps the dialog open with the cause; a good one is then written.
void tst_TagDefinitionDialog::refusedThenAcceptedValue()
{
    const auto mine = definition("number");
    Values values{TagValue::forDefinition(*mine, "3")};
    QString shownName;
    bool stayedOpen = false;
    QString message;
    ModalAnswer::actOnNextModal([&](QWidget* dialog) {
        shownName = dialog->findChild<QLabel*>("nameLabel")->text();
        auto* edit = dialog->findChild<QLineEdit*>("valueEdit");
        QCOMPARE(edit->text(), QStringLiteral("3"));
        edit->setText("lots");
        dialog->findChild<QDialogButtonBox*>("buttonBox")->button(QDialogButtonBox::Ok)->click();
        stayedOpen = dialog->isVisible();
        message = dialog->findChild<QLabel*>("errorLabel")->text();
        edit->selectAll();
        QTest::keyClicks(edit, "4.25");
        QTest::keyClick(edit, Qt::Key_Return);
    });

    TagDefinitionDialog dialog;
    QVERIFY(dialog.edit(m_store.model(), values, mine));

    QCOMPARE(shownName, QStringLiteral("Batch"));
    QVERIFY(stayedOpen);
    QVERIFY2(message.contains("lots") && message.contains("number"), qPrintable(message));
    QCOMPARE(texts(values), QStringList{"4.25"});
}

void tst_TagDefinitionDialog::choiceOffersTheAllowedValues()
{
    const auto mine = definition("choice");
    Values values;
    QStringList offered;
    bool lineEditShown = true;
    ModalAnswer::actOnNextModal([&](QWidget* dialog) {
        auto* choice = dialog->findChild<QComboBox*>("valueChoice");
        lineEditShown = dialog->findChild<QLineEdit*>("valueEdit")->isVisible();
        for (int i = 0; i < choice->count(); ++i)
            offered << choice->itemText(i);
        QCOMPARE(choice->currentText(), QStringLiteral("7")); // the default
        choice->setCurrentIndex(2);
        dialog->findChild<QDialogButtonBox*>("buttonBox")->button(QDialogButtonBox::Ok)->click();
    });

    TagDefinitionDialog dialog;
    QVERIFY(dialog.edit(m_store.model(), values, mine));

    QVERIFY(!lineEditShown);
    QCOMPARE(offered, (QStringList{"7", "matt", "glänzend"}));
    QCOMPARE(texts(values), QStringList{"glänzend"});
}

QC_TEST_MAIN(tst_TagDefinitionDialog)
#include "tst_tagdefinitiondialog.moc"
