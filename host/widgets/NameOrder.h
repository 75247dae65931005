#pragma once

#include <QCollator>
#include <QLocale>
#include <QString>

namespace vemi {

// The order in which names are listed to people: case-insensitive, numbers by
// their value ("Part 2" before "Part 10"), letters with accents in their
// alphabet's place, by the rules of the given locale. The C locale, which
// knows no such rules, collates as English.
class NameOrder
{
public:
    explicit NameOrder(const QLocale& locale = QLocale());

    bool lessThan(const QString& a, const QString& b) const;
    QLocale locale() const { return m_collator.locale(); }

    // The order of the application's default locale, made once per thread.
    static const NameOrder& standard();

private:
    QCollator m_collator;
};

} // namespace vemi
