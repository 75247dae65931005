#pragma once

#include <QObject>
#include <QString>

#include <memory>
#include <string>
#include <vector>

class QPixmap;
class QRect;

namespace vemi {
class CheckPoint;
class CheckPointCouple;
class ColorStandardsLibrary;
class Command;
class ErrorInfo;
class MarloModel;
class MeasurementConfiguration;
class QCJobTemplate;
class Response;
class SchematicImage;
class Standard;
class TagDefinition;
class TagValue;
class ToleranceSet;
} // namespace vemi

// The editing model of the open job template, shared by the browser, the
// detail editor and the checkpoint editor. It holds the very template object
// that the host browser's tree node holds, so every change it makes is a
// change of the object the host later saves. Lives on the GUI thread.
class QCJobTemplateModel : public QObject
{
    Q_OBJECT

public:
    explicit QCJobTemplateModel(vemi::MarloModel& store);
    ~QCJobTemplateModel() override;

    // Requests the colour standards libraries, then makes jobTemplate the one
    // being edited. Emits nothing.
    void setJobTemplate(std::shared_ptr<vemi::QCJobTemplate> jobTemplate);
    // Empty until the first setJobTemplate.
    std::shared_ptr<vemi::QCJobTemplate> jobTemplate() const;
    void notifyMeasurementConfigLoaded();
    // Stores the template at once through the default dispatcher.
    void saveJobTemplate();

    // The operations below need a template to be set and emit nothing.
    void setDescription(const std::string& description);
    std::vector<std::shared_ptr<vemi::TagDefinition>> tagDefinitions() const;
    void setTagDefinitions(const std::vector<std::shared_ptr<vemi::TagDefinition>>& definitions);
    std::vector<std::shared_ptr<vemi::TagValue>> tagValues() const;
    void setTagValues(const std::vector<std::shared_ptr<vemi::TagValue>>& values);
    void setEnableRepeat(bool enable);

    // The check list. A checkpoint index counts the checkpoints of
    // QCJobTemplate::checkPoints(), couple members one by one; an item index
    // counts the entries of the check list, a couple once. Negative indices
    // are out of range.
    int checkPointCount() const;
    // Throws std::out_of_range for an index out of range.
    std::shared_ptr<vemi::CheckPoint> checkPointAt(int index) const;
    // -1 when the check list does not hold checkPoint.
    int checkZoneIndex(const std::shared_ptr<vemi::CheckPoint>& checkPoint) const;
    // Appends a checkpoint with an empty image, position and size.
    std::shared_ptr<vemi::CheckPoint> addCheckPoint(const QString& name);
    // Throws std::out_of_range for a checkpoint index out of range.
    void renameCheckPoint(int index, const QString& name);
    // Removes the item at an item index, a couple with both its members.
    void removeCheckListItem(int index);
    // Exchanges two items; emits nothing, the caller reports the move.
    void swapCheckListItems(int a, int b);
    // Replaces two checkpoints that are items of their own by a couple named
    // name, standing where the first one stood. Returns first, or -1 (and
    // changes nothing) when the two are not different single checkpoints.
    int coupleCheckPoints(int first, int second, const std::string& name);
    // Puts the members of the couple at an item index back as single items.
    void decoupleCheckPoints(int index);
    // Replaces the couple at an item index by one with its members exchanged.
    void swapCoupledCheckPoints(int index);

    // The largest schematic file that is read, in bytes.
    static constexpr qint64 MaximumSchematicFileBytes = 10'000'000;
    // Reads a schematic file: only a regular file of 1 to
    // MaximumSchematicFileBytes bytes, and never more than that, so that a
    // pipe or a device neither blocks nor floods the editor. Returns false
    // with the reason in *errorMessage otherwise.
    static bool readSchematicFile(const QString& path, std::vector<unsigned char>* bytes,
                                  QString* errorMessage = nullptr);
    // The schematic pictures. Returns false, with the reason in
    // *errorMessage, when the file cannot be read (see readSchematicFile);
    // the stored picture is then left as it was.
    bool loadSchematicImage(const QString& name, const QString& path, QString* errorMessage = nullptr);
    // The same with the file's bytes already read (readSchematicFile), so
    // that what is stored is exactly what the caller decoded and showed.
    void storeSchematicImage(const QString& name, const QString& path, std::vector<unsigned char> bytes);
    // Empties the template's picture and stores the template at once.
    void clearSchematicImage();
    // Stores area as the PNG cut-out of the checkpoint at a checkpoint index,
    // with rect as its position and size. Returns false, changing nothing,
    // for an empty area. Throws std::out_of_range for an index out of range.
    bool setCheckPointImage(int index, const QPixmap& area, const QRect& rect);

    // Standards, tolerances and the measurement configuration; only
    // setMeasurementConfiguration emits (sgMeasurementConfigLoaded).
    std::vector<std::shared_ptr<vemi::Standard>> standards() const;
    // Duplicates are the caller's to avoid; a null standard is ignored.
    void addStandard(const std::shared_ptr<vemi::Standard>& standard);
    // Replaces the standards by the library's, unless the library has none.
    void setStandardsFromLibrary(const std::shared_ptr<vemi::ColorStandardsLibrary>& library);
    void removeAllStandards();
    std::vector<std::shared_ptr<vemi::ToleranceSet>> sharedToleranceSets() const;
    void setSharedToleranceSets(const std::vector<std::shared_ptr<vemi::ToleranceSet>>& sets);
    // Empties the shared and the private tolerance sets.
    void removeAllToleranceSets();
    // May be empty.
    std::shared_ptr<vemi::MeasurementConfiguration> measurementConfiguration() const;
    // An empty handle removes the configuration.
    void setMeasurementConfiguration(const std::shared_ptr<vemi::MeasurementConfiguration>& configuration);

signals:
    void sgMeasurementConfigLoaded();
    void sgSetTemplateSavable();
    // The store refused the model's own save of the template (the one
    // clearSchematicImage makes); message names the cause.
    void sgTemplateSaveFailed(const QString& message);

private:
    using ResponseHandler = void (QCJobTemplateModel::*)(std::shared_ptr<vemi::Response>);
    using ErrorHandler = void (QCJobTemplateModel::*)(std::shared_ptr<vemi::ErrorInfo>);

    // Answers of the model's own commands change nothing here: a request's
    // only effect is on the store side.
    void onLibrariesReceived(std::shared_ptr<vemi::Response> response);
    void onTemplateSaved(std::shared_ptr<vemi::Response> response);
    void onTemplateSaveError(std::shared_ptr<vemi::ErrorInfo> error);
    void runCommand(std::shared_ptr<vemi::Command> command, ResponseHandler onResponse,
                    ErrorHandler onError = nullptr);

    bool isItemIndex(int index) const;
    bool isCheckPointIndex(int index) const;
    // Null unless the item at an item index is a couple.
    std::shared_ptr<vemi::CheckPointCouple> coupleAt(int index) const;
    // Removes every item that is checkPoint itself and emits sgSetTemplateSavable.
    void removeCheckPointItem(const std::shared_ptr<vemi::CheckPoint>& checkPoint);
    // The template's picture, made first when the template has none.
    std::shared_ptr<vemi::SchematicImage> templateSchematic();

    vemi::MarloModel& m_store;
    std::shared_ptr<vemi::QCJobTemplate> m_template;
};
