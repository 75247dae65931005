#include "host/widgets/TagValueEdit.h"

#include "host/domain/TagDefinition.h"
#include "host/domain/TagValue.h"

#include <QCoreApplication>
#include <QLocale>

#include <algorithm>

namespace vemi {

namespace {

bool isNumber(const QString& text)
{
    bool ok = false;
    QLocale().toDouble(text, &ok);
    if (!ok)
        QLocale::c().toDouble(text, &ok);
    return ok;
}

QString tr(const char* text)
{
    return QCoreApplication::translate("vemi::TagValueEdit", text);
}

} // namespace

std::shared_ptr<TagValue> TagValueEdit::valueOf(const std::vector<std::shared_ptr<TagValue>>& values,
                                                const TagDefinition& definition)
{
    const auto found = std::find_if(values.begin(), values.end(), [&](const std::shared_ptr<TagValue>& value) {
        return value && value->definitionId() == definition.id();
    });
    return found == values.end() ? nullptr : *found;
}

std::string TagValueEdit::shownValue(const std::vector<std::shared_ptr<TagValue>>& values,
                                     const TagDefinition& definition)
{
    const auto value = valueOf(values, definition);
    return value ? value->value() : definition.defaultValue();
}

QString TagValueEdit::rejection(const TagDefinition& definition, const QString& text)
{
    const QString trimmed = text.trimmed();
    if (trimmed.isEmpty())
        return {};
    const QString name = QString::fromStdString(definition.name());
    const std::vector<std::string> allowed = definition.allowedValues();
    if (!allowed.empty() && std::find(allowed.begin(), allowed.end(), text.toStdString()) == allowed.end())
        return tr("Cannot set property \"%1\": \"%2\" is not one of its allowed values.").arg(name, text);
    if (definition.valueKind() == TagDefinition::ValueKind::Number && !isNumber(trimmed))
        return tr("Cannot set property \"%1\": \"%2\" is not a number.").arg(name, text);
    return {};
}

bool TagValueEdit::write(std::vector<std::shared_ptr<TagValue>>& values, const TagDefinition& definition,
                         const std::string& text)
{
    if (text == shownValue(values, definition))
        return false;
    auto replacement = TagValue::forDefinition(definition, text);
    const auto old = valueOf(values, definition);
    if (!old) {
        values.push_back(replacement);
        return true;
    }
    replacement->setId(old->id());
    std::replace(values.begin(), values.end(), old, replacement);
    return true;
}

} // namespace vemi
