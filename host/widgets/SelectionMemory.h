#pragma once

#include "host/widgets/BaseObjectTreeModel.h"

#include <QString>

#include <string>

namespace vemi {

// Remembers a browser's last selected stored entry in the default QSettings,
// so that the browser selects it again at its next start.
class SelectionMemory
{
public:
    // settingsName (the client's) and typeId together name the settings key.
    void setKey(const std::string& settingsName, const std::string& typeId);
    // Remembers node when it is a stored entry; anything else keeps what was remembered.
    void remember(const BaseObjectTreeModel::Node* node) const;
    // The key (keyOf) of the remembered entry; empty when there is none.
    std::string remembered() const;

    // What identifies node across reloads of the tree: "folder:<id>",
    // "entry:<id>", for an object not saved yet "object:<id>"; empty for none.
    static std::string keyOf(const BaseObjectTreeModel::Node* node);

private:
    QString m_settingsKey;
};

} // namespace vemi
