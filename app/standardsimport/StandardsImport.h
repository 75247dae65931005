#pragma once

#include <QByteArray>
#include <QString>
#include <QStringList>

#include <array>
#include <atomic>
#include <memory>
#include <string>
#include <optional>
#include <vector>

namespace vemi {

class AddObjectSet;

// A CGATS file of colour measurements on its way into the store as one colour
// standards library with one standard per sample, in file order. Reading the
// file checks all of it; building turns the samples into standards under a
// colorimetric condition and gives the one store command that writes them.
// Neither touches the store or any widget, so both may run on any thread.
class StandardsImport
{
public:
    // An illuminant and observer the import has tables for, as values
    // (ColorimetricCondition is a store object, which is not copied).
    struct Condition
    {
        std::string illuminant;
        std::string observer;
        std::string toString() const { return illuminant + "/" + observer; }
    };

    struct Sample
    {
        QString name; // unique in the file: a repeated name is numbered ("Red 2")
        QString id;   // SAMPLE_ID, may be empty
        std::array<double, 3> lab{};
        std::vector<double> reflectance; // factors, one per wavelength(), for spectral files
    };

    static const char* const kDefaultFolder; // "Imported"
    static Condition defaultCondition(); // D65/10

    // Null on failure, with *error naming the file, the line or sample, and the cause.
    static std::unique_ptr<StandardsImport> readFile(const QString& path, QString* error);
    static std::unique_ptr<StandardsImport> readBytes(const QByteArray& bytes, const QString& fileName,
                                                      QString* error);
    // "D50/2" into a condition of illuminant and observer the import has tables for.
    static std::optional<Condition> parseCondition(const QString& text);
    // The conditions a user may choose, "D65/10" first.
    static QStringList conditionChoices();

    QString fileName() const { return m_fileName; }
    QString libraryName() const { return m_libraryName; }
    const std::vector<Sample>& samples() const { return m_samples; }
    // Lab is computed from reflectance spectra (the file has no Lab columns).
    bool isSpectral() const { return !m_wavelengths.empty(); }
    const std::vector<double>& wavelengths() const { return m_wavelengths; }
    // True when the file's keywords name both illuminant and observer.
    bool namesCondition() const { return m_namesIlluminant && m_namesObserver; }
    // What the file leaves open: "illuminant and observer", "observer" or "illuminant".
    QString missingConditionParts() const;
    // The file's illuminant and observer, where it names them, else the defaults.
    Condition condition() const { return m_condition; }
    // What the user should know besides the count: tables left out, how spectra were read.
    QStringList notes() const { return m_notes; }

    // The library and its standards under condition, filed in folderName of the
    // library tree and folderName/<library name> of the standards tree. done
    // counts the samples converted; a set cancelled ends the build early with
    // null and no error. Null with *error when the condition cannot be used.
    std::shared_ptr<AddObjectSet> build(const Condition& condition, const QString& folderName,
                                        QString* error, std::atomic<int>* done = nullptr,
                                        const std::atomic<bool>* cancelled = nullptr) const;

private:
    StandardsImport() = default;

    QString m_fileName;
    QString m_libraryName;
    QString m_originator;
    std::vector<Sample> m_samples;
    std::vector<double> m_wavelengths;
    Condition m_condition;
    bool m_namesIlluminant = false;
    bool m_namesObserver = false;
    QStringList m_notes;
};

} // namespace vemi
