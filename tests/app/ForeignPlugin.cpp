// A Qt plug-in of another interface: the shell must skip it.
#include <QObject>
#include <QtPlugin>

class ForeignPlugin : public QObject
{
    Q_OBJECT
    Q_PLUGIN_METADATA(IID "org.example.SomethingElse")
};

#include "ForeignPlugin.moc"
