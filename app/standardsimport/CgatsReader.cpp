#include "app/standardsimport/CgatsReader.h"

#include <QRegularExpression>
#include <QTextCodec>

#include <lcms2.h>

#include <memory>

namespace vemi {

namespace {

// A word as Little CMS splits the text: a bare word or a quoted string.
struct Word
{
    int line;
    int begin;
    int end;
    bool quoted;
};

// Splits the text the way Little CMS's scanner does as far as words and lines
// go: blanks separate words, "…" and '…' are strings, # starts a comment that
// runs to the end of the line.
std::vector<Word> wordsOf(const QByteArray& text)
{
    std::vector<Word> words;
    int line = 1;
    int i = 0;
    const int size = text.size();
    while (i < size) {
        const char c = text[i];
        if (c == '\n') {
            ++line;
            ++i;
        } else if (c == ' ' || c == '\t' || c == '\r') {
            ++i;
        } else if (c == '#') {
            while (i < size && text[i] != '\n')
                ++i;
        } else if (c == '"' || c == '\'') {
            const int begin = i++;
            while (i < size && text[i] != c && text[i] != '\n')
                ++i;
            words.push_back({line, begin, i < size ? ++i : i, true});
        } else {
            const int begin = i;
            while (i < size && !QByteArray(" \t\r\n#\"'").contains(text[i]))
                ++i;
            words.push_back({line, begin, i, false});
        }
    }
    return words;
}

bool isWord(const QByteArray& text, const Word& word, const char* keyword)
{
    return !word.quoted && text.mid(word.begin, word.end - word.begin).compare(keyword, Qt::CaseInsensitive) == 0;
}

// Little CMS takes only ASCII in bare words; names written in other letters
// (Grün, 赤) are put in quotes, which it reads as they stand. Lines keep their numbers.
QByteArray quoteNonAsciiWords(const QByteArray& text, const std::vector<Word>& words)
{
    QByteArray quoted;
    quoted.reserve(text.size() + 64);
    int copied = 0;
    for (const Word& word : words) {
        if (word.quoted)
            continue;
        bool ascii = true;
        for (int i = word.begin; i < word.end && ascii; ++i)
            ascii = static_cast<unsigned char>(text[i]) < 0x80;
        if (ascii)
            continue;
        quoted.append(text.constData() + copied, word.begin - copied);
        quoted.append('"').append(text.constData() + word.begin, word.end - word.begin).append('"');
        copied = word.end;
    }
    quoted.append(text.constData() + copied, text.size() - copied);
    return quoted;
}

// Little CMS reads the data as one stream of values and deals them out row by
// row, so a row one value short followed by one a value long would shift every
// value in between into the wrong column without complaint. Each line of the
// first data block must hold one whole row, and there must be as many rows as
// NUMBER_OF_SETS says; returns the line of each row.
std::optional<std::vector<int>> rowLinesOf(const QByteArray& text, const std::vector<Word>& words, QString* error)
{
    size_t i = 0;
    int declaredRows = -1;
    int declaredLine = 0;
    const auto noteDeclaredRows = [&](size_t at) {
        if (!isWord(text, words[at], "NUMBER_OF_SETS") || at + 1 >= words.size())
            return;
        bool number = false;
        const int rows = text.mid(words[at + 1].begin, words[at + 1].end - words[at + 1].begin).toInt(&number);
        declaredRows = number ? rows : -1;
        declaredLine = words[at].line;
    };
    while (i < words.size() && !isWord(text, words[i], "BEGIN_DATA_FORMAT")) {
        noteDeclaredRows(i);
        ++i;
    }
    int fieldCount = 0;
    for (++i; i < words.size() && !isWord(text, words[i], "END_DATA_FORMAT"); ++i)
        ++fieldCount;
    while (i < words.size() && !isWord(text, words[i], "BEGIN_DATA")) {
        noteDeclaredRows(i);
        ++i;
    }
    std::vector<int> lines;
    if (i >= words.size() || fieldCount == 0)
        return lines; // Little CMS names what is missing
    ++i;
    while (i < words.size() && !isWord(text, words[i], "END_DATA")) {
        const int line = words[i].line;
        int count = 0;
        for (; i < words.size() && words[i].line == line && !isWord(text, words[i], "END_DATA"); ++i)
            ++count;
        if (count != fieldCount) {
            *error = QStringLiteral("line %1: the row has %2 values, but the data format names %3 fields")
                         .arg(line).arg(count).arg(fieldCount);
            return std::nullopt;
        }
        lines.push_back(line);
    }
    if (declaredRows >= 0 && declaredRows != int(lines.size())) {
        *error = QStringLiteral("line %1: NUMBER_OF_SETS is %2, but the data holds %3 rows")
                     .arg(declaredLine).arg(declaredRows).arg(lines.size());
        return std::nullopt;
    }
    return lines;
}

// Little CMS reports faults through its context's log handler.
struct Messages
{
    QStringList texts;
};

void collect(cmsContext context, cmsUInt32Number, const char* text)
{
    static_cast<Messages*>(cmsGetContextUserData(context))->texts << QString::fromUtf8(text).trimmed();
}

// "<file>: Line 12, Unrecognized character" → "line 12: Unrecognized character"
QString plainMessage(const QString& message)
{
    static const QRegularExpression located(QStringLiteral("Line (\\d+), (.*)$"),
                                            QRegularExpression::DotMatchesEverythingOption);
    const QRegularExpressionMatch match = located.match(message);
    if (!match.hasMatch())
        return message;
    return QStringLiteral("line %1: %2").arg(match.captured(1), match.captured(2).simplified());
}

struct ContextCloser
{
    void operator()(void* context) const { cmsDeleteContext(static_cast<cmsContext>(context)); }
};
struct TableCloser
{
    void operator()(void* handle) const { cmsIT8Free(static_cast<cmsHANDLE>(handle)); }
};

void readTable(cmsHANDLE handle, CgatsTable& table)
{
    table.tableCount = int(cmsIT8TableCount(handle));
    cmsIT8SetTable(handle, 0);
    char** names = nullptr;
    const cmsUInt32Number keywordCount = cmsIT8EnumProperties(handle, &names);
    for (cmsUInt32Number i = 0; i < keywordCount; ++i) {
        const char* value = cmsIT8GetProperty(handle, names[i]);
        table.keywords[QByteArray(names[i]).toUpper().toStdString()] = value ? value : "";
    }
    // WEIGHTING_FUNCTION "ILLUMINANT, D50" and "OBSERVER, 2" are pairs that
    // Little CMS keeps under the keyword; each is kept as "WEIGHTING_FUNCTION ILLUMINANT".
    for (const char* part : {"ILLUMINANT", "OBSERVER"}) {
        if (const char* value = cmsIT8GetPropertyMulti(handle, "WEIGHTING_FUNCTION", part))
            table.keywords[std::string("WEIGHTING_FUNCTION ") + part] = value;
    }
    char** fields = nullptr;
    const int fieldCount = cmsIT8EnumDataFormat(handle, &fields);
    for (int i = 0; i < fieldCount; ++i)
        table.fields.emplace_back(fields[i] ? fields[i] : "");
    const int rowCount = int(cmsIT8GetPropertyDbl(handle, "NUMBER_OF_SETS"));
    table.rows.reserve(size_t(std::max(rowCount, 0)));
    for (int row = 0; row < rowCount; ++row) {
        std::vector<std::string> cells;
        cells.reserve(size_t(fieldCount));
        for (int column = 0; column < fieldCount; ++column) {
            const char* cell = cmsIT8GetDataRowCol(handle, row, column);
            cells.emplace_back(cell ? cell : "");
        }
        table.rows.push_back(std::move(cells));
    }
}

bool isUtf8(const QByteArray& bytes)
{
    QTextCodec::ConverterState state;
    QTextCodec::codecForName("UTF-8")->toUnicode(bytes.constData(), bytes.size(), &state);
    return state.invalidChars == 0;
}

} // namespace

std::optional<CgatsTable> CgatsReader::read(const QByteArray& bytes, QString* error)
{
    if (bytes.contains('\0')) {
        *error = QStringLiteral("it is not a text file, so not a CGATS file");
        return std::nullopt;
    }
    const std::vector<Word> words = wordsOf(bytes);
    const QByteArray text = quoteNonAsciiWords(bytes, words);
    const auto rowLines = rowLinesOf(bytes, words, error);
    if (!rowLines)
        return std::nullopt;

    Messages messages;
    std::unique_ptr<void, ContextCloser> context(cmsCreateContext(nullptr, &messages));
    if (!context) {
        *error = QStringLiteral("Little CMS could not start");
        return std::nullopt;
    }
    const auto lcms = static_cast<cmsContext>(context.get());
    cmsSetLogErrorHandlerTHR(lcms, collect);
    std::unique_ptr<void, TableCloser> handle(cmsIT8LoadFromMem(lcms, text.constData(), cmsUInt32Number(text.size())));
    // Little CMS may hand back a half-read table after a fault; any message is a failure.
    if (!messages.texts.isEmpty()) {
        *error = plainMessage(messages.texts.first());
        return std::nullopt;
    }
    if (!handle) {
        *error = QStringLiteral("it is not a CGATS file");
        return std::nullopt;
    }

    CgatsTable table;
    readTable(handle.get(), table);
    if (!messages.texts.isEmpty()) {
        *error = plainMessage(messages.texts.first());
        return std::nullopt;
    }
    if (table.fields.empty() || table.rows.empty()) {
        *error = QStringLiteral("it holds no data table (BEGIN_DATA_FORMAT … END_DATA), so it is not a CGATS file"
                                " of measurements");
        return std::nullopt;
    }
    table.rowLines = *rowLines;
    table.rowLines.resize(table.rows.size(), 0);
    table.utf8 = isUtf8(bytes);
    return table;
}

} // namespace vemi
