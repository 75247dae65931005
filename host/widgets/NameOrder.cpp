#include "host/widgets/NameOrder.h"

namespace vemi {

namespace {

QLocale collationLocale(const QLocale& locale)
{
    if (locale.language() == QLocale::C)
        return QLocale(QLocale::English, QLocale::UnitedStates);
    return locale;
}

} // namespace

NameOrder::NameOrder(const QLocale& locale)
    : m_collator(collationLocale(locale))
{
    m_collator.setNumericMode(true);
    m_collator.setCaseSensitivity(Qt::CaseInsensitive);
}

bool NameOrder::lessThan(const QString& a, const QString& b) const
{
    const int order = m_collator.compare(a, b);
    // Names equal but for case still get a fixed order, so that a list
    // does not change between two sorts.
    return order != 0 ? order < 0 : a < b;
}

const NameOrder& NameOrder::standard()
{
    // QCollator is not safe to share between threads; a model may sort on
    // any thread it lives on.
    thread_local const NameOrder order;
    return order;
}

} // namespace vemi
