#pragma once

#include <QMenuBar>

namespace vemi {

// The host's top bar of one client tab: holds the menus the client gives it.
class CorvoTopBar : public QMenuBar
{
    Q_OBJECT

public:
    explicit CorvoTopBar(QWidget* parent = nullptr);

    // Takes ownership of the menu and shows it in the bar.
    void addMenu(QMenu* menu);
};

} // namespace vemi
