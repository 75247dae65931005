#pragma once

#include <QString>
#include <QTemporaryDir>

#include <memory>

// A throw-away PostgreSQL server for the tests: initdb into a temporary
// folder, the server's Unix socket in that folder, no TCP port. As root it
// runs as the user "postgres" (the server refuses to run as root). It is
// stopped when the test program ends, and by a watchdog should the program
// die without ending properly.
class TestPostgresServer
{
public:
    // The one server of the test program, started with the first call; null
    // when it cannot run here (skipReason() says why).
    static TestPostgresServer* shared();
    static QString skipReason();

    ~TestPostgresServer();

    // A new empty database; its postgresql:// address.
    QString createDatabase();
    // The address of a database with another user name, to be refused.
    QString addressAs(const QString& user, const QString& database) const;
    // Stops the server at once, as a crash would; start() brings it back
    // (and does nothing while it runs).
    bool kill();
    bool start();

private:
    TestPostgresServer() = default;
    bool setUp();
    bool runAsServerUser(const QString& program, const QStringList& arguments, int timeoutMs,
                         QString* output = nullptr);
    void startWatchdog();

    QTemporaryDir m_dir;
    QString m_binDir;
    bool m_asPostgresUser = false;
    bool m_running = false;
    int m_databases = 0;
};
