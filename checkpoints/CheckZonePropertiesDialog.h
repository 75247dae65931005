#pragma once

#include <QDialog>

#include <memory>
#include <vector>

class QCheckBox;
class QCJobTemplateModel;
class QLineEdit;

namespace vemi {
class CheckPoint;
class MarloModel;
class Standard;
class TagDefinition;
class TagValue;
} // namespace vemi

// Edits a copy of one checkpoint's name and skippable flag; the caller reads
// the results after an accepted exec() and writes them back.
class CheckZonePropertiesDialog : public QDialog
{
    Q_OBJECT

public:
    CheckZonePropertiesDialog(std::shared_ptr<vemi::CheckPoint> checkPoint,
                              std::shared_ptr<QCJobTemplateModel> model, QWidget* parent);

    // Not owned; set before exec().
    void setMarloModel(vemi::MarloModel* store);

    QString name() const;
    bool skippable() const;
    std::shared_ptr<vemi::Standard> standard() const;
    std::vector<std::shared_ptr<vemi::TagDefinition>> tagDefinitions() const;
    std::vector<std::shared_ptr<vemi::TagValue>> tagValues() const;

private:
    std::shared_ptr<vemi::CheckPoint> m_checkPoint;
    std::shared_ptr<QCJobTemplateModel> m_model;
    vemi::MarloModel* m_store = nullptr;
    QLineEdit* m_name;
    QCheckBox* m_skippable;
};
