#pragma once

#include <QWidget>

class QListWidgetItem;

namespace Ui {
class CheckZoneListItem;
}

// One checkpoint in a row of the check list: its number, the thumbnail of its
// schematic area and its name, editable in place. Knows nothing of the
// template; the editor listens to its signals.
class CheckZoneListItem : public QWidget
{
    Q_OBJECT

public:
    explicit CheckZoneListItem(QWidget* parent = nullptr);
    ~CheckZoneListItem() override;

    // The checkpoint index in the template's flat checkpoint list; shown plus one.
    void setNumber(int number);
    int number() const;
    void setName(const QString& name);
    QString name() const;
    // Shows pixmap at its own size, clipped by the 55 x 55 view.
    void setThumbnail(const QPixmap& pixmap);
    // Marks the frame for the host style sheet's "isSelected" rule.
    void setSelected(bool selected);
    bool isSelected() const;
    // Puts the cursor into the name with the whole name selected.
    void focusName();
    // The row this item was made for; not owned, may be null.
    void setListItem(QListWidgetItem* item);
    QListWidgetItem* listItem() const;

signals:
    void sgSetListItemText(int czIndex, QString name);
    void sgSetListItemSelected(QListWidgetItem* item);

protected:
    void changeEvent(QEvent* event) override;

private slots:
    void on_checkZoneNameLineEdit_textChanged(QString arg1);
    void on_checkZoneNameLineEdit_editingFinished();
    void on_checkZoneNameLineEdit_selectionChanged();

private:
    void showNumber();

    Ui::CheckZoneListItem* m_ui;
    int m_number = -1;
    QListWidgetItem* m_listItem = nullptr;
};
