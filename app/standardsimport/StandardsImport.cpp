#include "app/standardsimport/StandardsImport.h"

#include "app/standardsimport/CgatsReader.h"
#include "colour/CieTables.h"
#include "colour/LabToScreen.h"
#include "colour/SpectralToLab.h"
#include "host/domain/AppearanceValues.h"
#include "host/domain/ColorimetricCondition.h"
#include "host/domain/ColorStandardsLibrary.h"
#include "host/domain/LabValue.h"
#include "host/domain/RGBValue.h"
#include "host/domain/Standard.h"
#include "host/store/AddObjectSet.h"

#include <QFile>
#include <QFileInfo>
#include <QRegularExpression>
#include <QSet>

#include <algorithm>
#include <charconv>
#include <cmath>
#include <map>

namespace vemi {

namespace {

const char* const kLabFields[3] = {"LAB_L", "LAB_A", "LAB_B"};

QString failure(const QString& fileName, QString cause)
{
    while (cause.endsWith(QLatin1Char('.')))
        cause.chop(1);
    return QStringLiteral("Cannot import \"%1\": %2.").arg(fileName, cause);
}

// Numbers as CGATS writes them, whatever the user's locale: "-12.5", "1e-3".
std::optional<double> numberOf(const std::string& text)
{
    const char* begin = text.data();
    const char* end = begin + text.size();
    if (begin != end && *begin == '+')
        ++begin;
    double value = 0.0;
    const auto [stop, fault] = std::from_chars(begin, end, value);
    if (fault != std::errc() || stop != end || begin == end || !std::isfinite(value))
        return std::nullopt;
    return value;
}

bool knowsIlluminant(const std::string& name)
{
    const auto& names = CieTables::illuminantNames();
    return std::find(names.begin(), names.end(), name) != names.end();
}

QString knownIlluminants()
{
    QStringList names;
    for (const std::string& name : CieTables::illuminantNames())
        names << QString::fromStdString(name);
    return names.join(QStringLiteral(", "));
}

// The condition the file's keywords give, part by part.
struct FileCondition
{
    std::optional<std::string> illuminant;
    std::optional<std::string> observer;
    QString fault; // a named illuminant without tables
};

void takeIlluminant(const std::string& keyword, const QString& value, FileCondition& found)
{
    static const QRegularExpression illuminant(QStringLiteral("(?<![A-Z0-9])(A|B|C|E|D\\d{2}|F\\d{1,2})(?![A-Z0-9])"));
    const QRegularExpressionMatch match = illuminant.match(value);
    if (!match.hasMatch() || found.illuminant)
        return;
    const std::string name = match.captured(1).toStdString();
    if (knowsIlluminant(name))
        found.illuminant = name;
    else if (found.fault.isEmpty())
        found.fault = QStringLiteral("the keyword %1 names the illuminant %2, for which the import has no tables (%3)")
                          .arg(QString::fromStdString(keyword), match.captured(1), knownIlluminants());
}

void takeObserver(const QString& value, FileCondition& found)
{
    static const QRegularExpression observer(QStringLiteral("(?<![0-9.])(2|10|1931|1964)(?![0-9.])"));
    const QRegularExpressionMatch match = observer.match(value);
    if (!match.hasMatch() || found.observer)
        return;
    const QString angle = match.captured(1);
    found.observer = angle == QLatin1String("1931") ? "2" : angle == QLatin1String("1964") ? "10" : angle.toStdString();
}

FileCondition conditionOf(const std::map<std::string, std::string>& keywords)
{
    FileCondition found;
    const auto value = [&](const char* keyword) -> std::optional<QString> {
        const auto it = keywords.find(keyword);
        if (it == keywords.end())
            return std::nullopt;
        return QString::fromStdString(it->second).toUpper();
    };
    // "D50/2" and the like; other measurement conditions (M0 … M3) name neither.
    if (const auto text = value("MEASUREMENT_CONDITION")) {
        static const QRegularExpression pair(QStringLiteral("^\\s*([A-Z]\\d{0,2})\\s*/\\s*(\\d+)"));
        const QRegularExpressionMatch match = pair.match(*text);
        if (match.hasMatch()) {
            takeIlluminant("MEASUREMENT_CONDITION", match.captured(1), found);
            takeObserver(match.captured(2), found);
        }
    }
    for (const char* keyword : {"ILLUMINANT", "ILLUMINATION_NAME", "ILLUMINATION", "WEIGHTING_FUNCTION ILLUMINANT"}) {
        if (const auto text = value(keyword))
            takeIlluminant(keyword, *text, found);
    }
    for (const char* keyword : {"OBSERVER", "OBSERVER_ANGLE", "WEIGHTING_FUNCTION OBSERVER"}) {
        if (const auto text = value(keyword))
            takeObserver(*text, found);
    }
    return found;
}

// The spectral columns: wavelength and column, ascending by wavelength.
struct SpectralColumns
{
    std::vector<std::pair<double, int>> columns;
    bool percent = false;
    bool decimal = false;
};

SpectralColumns spectralColumnsOf(const CgatsTable& table)
{
    static const QRegularExpression spectral(QStringLiteral("^(SPECTRAL_NM|SPECTRAL_PCT|SPECTRAL_DEC|SPECTRAL|NM)_?(\\d{3})$"),
                                             QRegularExpression::CaseInsensitiveOption);
    SpectralColumns found;
    for (size_t i = 0; i < table.fields.size(); ++i) {
        const QRegularExpressionMatch match = spectral.match(QString::fromStdString(table.fields[i]));
        if (!match.hasMatch())
            continue;
        found.columns.emplace_back(match.captured(2).toDouble(), int(i));
        const QString kind = match.captured(1).toUpper();
        found.percent = found.percent || kind == QLatin1String("SPECTRAL_PCT");
        found.decimal = found.decimal || kind == QLatin1String("SPECTRAL_DEC");
    }
    std::sort(found.columns.begin(), found.columns.end());
    return found;
}

// Later samples that repeat an earlier name get the lowest free number.
void numberRepeatedNames(std::vector<StandardsImport::Sample>& samples)
{
    QSet<QString> taken;
    for (const auto& sample : samples)
        taken.insert(sample.name);
    QSet<QString> used;
    for (auto& sample : samples) {
        if (!used.contains(sample.name)) {
            used.insert(sample.name);
            continue;
        }
        int number = 2;
        QString candidate;
        do
            candidate = QStringLiteral("%1 %2").arg(sample.name).arg(number++);
        while (taken.contains(candidate) || used.contains(candidate));
        sample.name = candidate;
        used.insert(candidate);
    }
}

std::shared_ptr<Standard> makeStandard(const StandardsImport::Sample& sample, const std::array<double, 3>& lab,
                                       const std::string& condition, const LabToScreen& toScreen,
                                       const std::string& origin)
{
    auto value = std::make_shared<LabValue>(lab[0], lab[1], lab[2]);
    value->setColorimetricCondition(condition);
    auto appearance = std::make_shared<AppearanceValues>();
    appearance->setColorValues({value});
    const QColor colour = toScreen.convert(lab[0], lab[1], lab[2]);
    auto standard = std::make_shared<Standard>();
    standard->setName(sample.name.toStdString());
    standard->setDescription(sample.id.isEmpty() ? origin : origin + ", sample " + sample.id.toStdString());
    standard->setAppearanceValuesList({appearance});
    standard->setDisplayRGB(std::make_shared<RGBValue>(colour.red(), colour.green(), colour.blue()));
    return standard;
}

} // namespace

const char* const StandardsImport::kDefaultFolder = "Imported";

StandardsImport::Condition StandardsImport::defaultCondition()
{
    return {"D65", "10"};
}

std::optional<StandardsImport::Condition> StandardsImport::parseCondition(const QString& text)
{
    const QStringList parts = text.trimmed().split(QLatin1Char('/'));
    if (parts.size() != 2)
        return std::nullopt;
    const std::string illuminant = parts[0].trimmed().toUpper().toStdString();
    const std::string observer = parts[1].trimmed().toStdString();
    if (!knowsIlluminant(illuminant) || !CieTables::observer(observer))
        return std::nullopt;
    return Condition{illuminant, observer};
}

QStringList StandardsImport::conditionChoices()
{
    QStringList choices{QString::fromStdString(defaultCondition().toString())};
    for (const char* observer : {"10", "2"}) {
        for (const std::string& illuminant : CieTables::illuminantNames()) {
            const QString choice = QString::fromStdString(Condition{illuminant, observer}.toString());
            if (!choices.contains(choice))
                choices << choice;
        }
    }
    return choices;
}

QString StandardsImport::missingConditionParts() const
{
    if (m_namesIlluminant)
        return m_namesObserver ? QString() : QStringLiteral("observer");
    return m_namesObserver ? QStringLiteral("illuminant") : QStringLiteral("illuminant and observer");
}

std::unique_ptr<StandardsImport> StandardsImport::readFile(const QString& path, QString* error)
{
    const QString fileName = QFileInfo(path).fileName();
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly)) {
        *error = failure(fileName, file.errorString());
        return nullptr;
    }
    if (file.size() > CgatsReader::kMaxFileBytes) {
        *error = failure(fileName, QStringLiteral("the file is larger than %1 MB").arg(CgatsReader::kMaxFileBytes >> 20));
        return nullptr;
    }
    const QByteArray bytes = file.readAll();
    if (file.error() != QFileDevice::NoError) {
        *error = failure(fileName, file.errorString());
        return nullptr;
    }
    return readBytes(bytes, fileName, error);
}

std::unique_ptr<StandardsImport> StandardsImport::readBytes(const QByteArray& bytes, const QString& fileName,
                                                            QString* error)
{
    QString cause;
    const std::optional<CgatsTable> table = CgatsReader::read(bytes, &cause);
    if (!table) {
        *error = failure(fileName, cause);
        return nullptr;
    }
    const auto text = [&](const std::string& value) {
        return table->utf8 ? QString::fromStdString(value) : QString::fromLatin1(value.data(), int(value.size()));
    };
    const auto keyword = [&](const char* name) {
        const auto it = table->keywords.find(name);
        return it == table->keywords.end() ? QString() : text(it->second).trimmed();
    };

    std::unique_ptr<StandardsImport> import(new StandardsImport);
    import->m_fileName = fileName;
    import->m_libraryName = keyword("DESCRIPTOR");
    if (import->m_libraryName.isEmpty())
        import->m_libraryName = QFileInfo(fileName).completeBaseName();
    if (import->m_libraryName.isEmpty())
        import->m_libraryName = QStringLiteral("Imported standards");
    import->m_originator = keyword("ORIGINATOR");
    if (table->tableCount > 1)
        import->m_notes << QStringLiteral("The file holds %1 tables; the first was imported.").arg(table->tableCount);

    const FileCondition found = conditionOf(table->keywords);
    if (!found.fault.isEmpty()) {
        *error = failure(fileName, found.fault);
        return nullptr;
    }
    import->m_namesIlluminant = found.illuminant.has_value();
    import->m_namesObserver = found.observer.has_value();
    import->m_condition = Condition{found.illuminant.value_or(defaultCondition().illuminant),
                                    found.observer.value_or(defaultCondition().observer)};

    // The columns the values come from: Lab where the file has it, else spectra.
    std::vector<int> valueColumns;
    int labColumns = 0;
    for (const char* field : kLabFields)
        labColumns += table->column(field) >= 0 ? 1 : 0;
    const SpectralColumns spectral = spectralColumnsOf(*table);
    if (labColumns == 3) {
        for (const char* field : kLabFields)
            valueColumns.push_back(table->column(field));
    } else if (labColumns > 0) {
        *error = failure(fileName, QStringLiteral("the data format names some of LAB_L, LAB_A and LAB_B but not all"));
        return nullptr;
    } else if (spectral.columns.size() >= 2) {
        for (const auto& [nm, column] : spectral.columns) {
            if (!import->m_wavelengths.empty() && import->m_wavelengths.back() == nm) {
                *error = failure(fileName, QStringLiteral("the data format names the wavelength %1 nm twice").arg(nm));
                return nullptr;
            }
            import->m_wavelengths.push_back(nm);
            valueColumns.push_back(column);
        }
    } else {
        *error = failure(fileName, QStringLiteral("it has no Lab data (LAB_L, LAB_A, LAB_B) and no spectral data"
                                                  " (SPECTRAL_NM380 …)"));
        return nullptr;
    }

    const int nameColumn = table->column("SAMPLE_NAME");
    const int idColumn = table->column("SAMPLE_ID");
    double largest = 0.0;
    import->m_samples.reserve(table->rows.size());
    for (size_t row = 0; row < table->rows.size(); ++row) {
        const std::vector<std::string>& cells = table->rows[row];
        Sample sample;
        sample.id = idColumn >= 0 ? text(cells[size_t(idColumn)]).trimmed() : QString();
        sample.name = nameColumn >= 0 ? text(cells[size_t(nameColumn)]).trimmed() : QString();
        if (sample.name.isEmpty())
            sample.name = sample.id.isEmpty() ? QStringLiteral("Sample %1").arg(row + 1) : sample.id;
        std::vector<double> values;
        values.reserve(valueColumns.size());
        for (int column : valueColumns) {
            const std::optional<double> value = numberOf(cells[size_t(column)]);
            if (!value) {
                const int line = table->rowLines[row];
                *error = failure(fileName, QStringLiteral("sample %1 (\"%2\"%3): %4 is \"%5\", not a number")
                                               .arg(row + 1)
                                               .arg(sample.name, line > 0 ? QStringLiteral(", line %1").arg(line) : QString(),
                                                    QString::fromStdString(table->fields[size_t(column)]),
                                                    text(cells[size_t(column)])));
                return nullptr;
            }
            values.push_back(*value);
            largest = std::max(largest, *value);
        }
        if (labColumns == 3)
            sample.lab = {values[0], values[1], values[2]};
        else
            sample.reflectance = std::move(values);
        import->m_samples.push_back(std::move(sample));
    }
    numberRepeatedNames(import->m_samples);

    // Reflectance comes as factors (0–1) or in percent; fields that do not say
    // which are taken as percent when a value is larger than any factor can be.
    if (import->isSpectral()) {
        const bool percent = spectral.percent || (!spectral.decimal && largest > 2.0);
        if (percent) {
            for (Sample& sample : import->m_samples) {
                for (double& value : sample.reflectance)
                    value /= 100.0;
            }
        }
        import->m_notes << QStringLiteral("Lab was computed from the spectra (%1–%2 nm, read as %3).")
                               .arg(import->m_wavelengths.front())
                               .arg(import->m_wavelengths.back())
                               .arg(percent ? QStringLiteral("percent") : QStringLiteral("factors"));
    }
    return import;
}

std::shared_ptr<AddObjectSet> StandardsImport::build(const Condition& condition, const QString& folderName,
                                                     QString* error, std::atomic<int>* done,
                                                     const std::atomic<bool>* cancelled) const
{
    const std::string conditionText = condition.toString();
    const auto toScreen = LabToScreen::create(ColorimetricCondition(condition.illuminant, "2"));
    std::unique_ptr<SpectralToLab> fromSpectrum;
    if (isSpectral())
        fromSpectrum = SpectralToLab::create(ColorimetricCondition(condition.illuminant, condition.observer),
                                             m_wavelengths);
    if (!toScreen || (isSpectral() && !fromSpectrum)) {
        *error = failure(m_fileName, QStringLiteral("the import has no tables for the condition %1")
                                         .arg(QString::fromStdString(conditionText)));
        return nullptr;
    }

    std::string origin = "Imported from " + m_fileName.toStdString();
    std::vector<std::shared_ptr<Standard>> standards;
    standards.reserve(m_samples.size());
    for (const Sample& sample : m_samples) {
        if (cancelled && cancelled->load())
            return nullptr;
        const std::array<double, 3> lab = fromSpectrum ? fromSpectrum->lab(sample.reflectance.data()) : sample.lab;
        standards.push_back(makeStandard(sample, lab, conditionText, *toScreen, origin));
        if (done)
            ++*done;
    }

    auto library = std::make_shared<ColorStandardsLibrary>();
    library->setName(m_libraryName.toStdString());
    std::string description = origin;
    if (!m_originator.isEmpty())
        description += " (" + m_originator.toStdString() + ")";
    library->setDescription(description + ": " + std::to_string(standards.size()) + " standards under "
                            + conditionText + ".");
    library->setStandards(standards);

    const std::string folder = folderName.toStdString();
    auto set = std::make_shared<AddObjectSet>("import \"" + m_fileName.toStdString() + "\"");
    const auto libraryFolder = set->addFolder(ColorStandardsLibrary::typeId(), AddObjectSet::kTopLevel, folder);
    const auto standardsParent = set->addFolder(Standard::typeId(), AddObjectSet::kTopLevel, folder);
    const auto standardsFolder = set->addFolder(Standard::typeId(), standardsParent, m_libraryName.toStdString());
    for (const auto& standard : standards)
        set->addObject(*standard, standardsFolder);
    set->addObject(*library, libraryFolder);
    return set;
}

} // namespace vemi
