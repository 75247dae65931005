#pragma once

#include <QString>
#include <QWidget>

class CheckZoneListItem;

namespace Ui {
class CheckPointCouplet;
}

// The widget of one check-list row: one checkpoint item, or two stacked
// items with the couple's letter beside them. Owns its items through the Qt
// parent tree once they are set.
class CheckPointCouplet : public QWidget
{
    Q_OBJECT

public:
    explicit CheckPointCouplet(QWidget* parent = nullptr);
    ~CheckPointCouplet() override;

    void setFirstItem(CheckZoneListItem* item);
    void setSecondItem(CheckZoneListItem* item);
    // The first item for 1, the second for any other value; may be null.
    CheckZoneListItem* item(int i) const;
    // The first item's checkpoint index.
    int number() const;
    bool isCoupled() const;
    QString letter() const;
    // The row's position in the template's check list.
    int checkListIndex() const;
    void setCheckListIndex(int index);
    void setCoupled(bool on, const QString& letter);

protected:
    void changeEvent(QEvent* event) override;

private:
    Ui::CheckPointCouplet* m_ui;
    int m_checkListIndex = -1;
    CheckZoneListItem* m_firstItem = nullptr;
    CheckZoneListItem* m_secondItem = nullptr;
    bool m_coupled = false;
    QString m_letter;
};
