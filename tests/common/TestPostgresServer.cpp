#include "tests/common/TestPostgresServer.h"

#include "host/store/PostgresDialect.h"

#include <QCoreApplication>
#include <QDir>
#include <QFileInfo>
#include <QProcess>
#include <QSqlDatabase>
#include <QSqlError>
#include <QSqlQuery>
#include <QStandardPaths>
#include <QUrl>

#include <pwd.h>
#include <unistd.h>

#include <algorithm>
#include <cstdlib>

namespace {

QString s_skipReason;
std::unique_ptr<TestPostgresServer> s_server;
bool s_tried = false;

// initdb and pg_ctl: on the PATH, or where Debian keeps them.
QString findBinDir()
{
    const QString onPath = QStandardPaths::findExecutable(QStringLiteral("pg_ctl"));
    if (!onPath.isEmpty())
        return QFileInfo(onPath).absolutePath();
    QDir versions(QStringLiteral("/usr/lib/postgresql"));
    QStringList found = versions.entryList(QDir::Dirs | QDir::NoDotAndDotDot, QDir::Name);
    std::sort(found.begin(), found.end(), [](const QString& a, const QString& b) { return a.toInt() > b.toInt(); });
    for (const QString& version : found) {
        const QString bin = versions.filePath(version + QStringLiteral("/bin"));
        if (QFileInfo::exists(bin + QStringLiteral("/pg_ctl")))
            return bin;
    }
    return QString();
}

void stopShared()
{
    s_server.reset();
}

} // namespace

TestPostgresServer* TestPostgresServer::shared()
{
    if (!s_tried) {
        s_tried = true;
        std::unique_ptr<TestPostgresServer> server(new TestPostgresServer);
        if (server->setUp()) {
            s_server = std::move(server);
            std::atexit(stopShared);
            qAddPostRoutine(stopShared);
        }
    }
    return s_server.get();
}

QString TestPostgresServer::skipReason()
{
    return s_skipReason;
}

bool TestPostgresServer::setUp()
{
    if (!QSqlDatabase::isDriverAvailable(QStringLiteral("QPSQL"))) {
        s_skipReason = QStringLiteral("the PostgreSQL driver for Qt is missing (package libqt5sql5-psql)");
        return false;
    }
    m_binDir = findBinDir();
    if (m_binDir.isEmpty()) {
        s_skipReason = QStringLiteral("the PostgreSQL server programs are missing (package postgresql)");
        return false;
    }
    if (geteuid() == 0) {
        const passwd* user = getpwnam("postgres");
        if (!user || chown(QFile::encodeName(m_dir.path()).constData(), user->pw_uid, user->pw_gid) != 0) {
            s_skipReason = QStringLiteral("running as root, and there is no user \"postgres\" to run the server as");
            return false;
        }
        m_asPostgresUser = true;
    }
    QString output;
    if (!runAsServerUser(m_binDir + QStringLiteral("/initdb"),
                         {QStringLiteral("-D"), m_dir.filePath(QStringLiteral("data")), QStringLiteral("--auth=trust"),
                          QStringLiteral("-U"), QStringLiteral("postgres"), QStringLiteral("-E"), QStringLiteral("UTF8"),
                          QStringLiteral("--no-sync")},
                         60000, &output)) {
        s_skipReason = QStringLiteral("initdb failed: ") + output;
        return false;
    }
    if (!start()) {
        s_skipReason = QStringLiteral("the test server did not start; see ") + m_dir.filePath(QStringLiteral("log"));
        m_dir.setAutoRemove(false);
        return false;
    }
    startWatchdog();
    return true;
}

TestPostgresServer::~TestPostgresServer()
{
    kill();
}

bool TestPostgresServer::runAsServerUser(const QString& program, const QStringList& arguments, int timeoutMs,
                                         QString* output)
{
    QProcess process;
    process.setWorkingDirectory(m_dir.path());
    process.setProcessChannelMode(QProcess::MergedChannels);
    if (m_asPostgresUser)
        process.start(QStringLiteral("runuser"), QStringList{QStringLiteral("-u"), QStringLiteral("postgres"),
                                                             QStringLiteral("--"), program} + arguments);
    else
        process.start(program, arguments);
    const bool finished = process.waitForFinished(timeoutMs);
    if (!finished)
        process.kill();
    if (output)
        *output = QString::fromLocal8Bit(process.readAll());
    return finished && process.exitStatus() == QProcess::NormalExit && process.exitCode() == 0;
}

bool TestPostgresServer::start()
{
    if (m_running)
        return true;
    const QString options = QStringLiteral("-c listen_addresses='' -c unix_socket_directories='%1' -c fsync=off")
                                .arg(m_dir.path());
    m_running = runAsServerUser(m_binDir + QStringLiteral("/pg_ctl"),
                                {QStringLiteral("-D"), m_dir.filePath(QStringLiteral("data")), QStringLiteral("-l"),
                                 m_dir.filePath(QStringLiteral("log")), QStringLiteral("-w"), QStringLiteral("-t"),
                                 QStringLiteral("30"), QStringLiteral("-o"), options, QStringLiteral("start")},
                                40000);
    return m_running;
}

// Tried even when the server is thought stopped: a server left running would
// outlive the tests.
bool TestPostgresServer::kill()
{
    const bool stopped = runAsServerUser(m_binDir + QStringLiteral("/pg_ctl"),
                                         {QStringLiteral("-D"), m_dir.filePath(QStringLiteral("data")),
                                          QStringLiteral("-m"), QStringLiteral("immediate"), QStringLiteral("-w"),
                                          QStringLiteral("stop")},
                                         30000);
    m_running = false;
    return stopped;
}

// Stops the server once this program is gone, however it ended.
void TestPostgresServer::startWatchdog()
{
    const QString script =
        QStringLiteral("while kill -0 %1 2>/dev/null; do sleep 1; done; %2 pg_ctl -D '%3' -m immediate stop >/dev/null 2>&1")
            .arg(QCoreApplication::applicationPid())
            .arg(m_asPostgresUser ? QStringLiteral("runuser -u postgres --") : QString())
            .arg(m_dir.filePath(QStringLiteral("data")));
    QProcess::startDetached(QStringLiteral("sh"), {QStringLiteral("-c"),
                                                   QStringLiteral("PATH='%1':$PATH; %2").arg(m_binDir, script)});
}

QString TestPostgresServer::addressAs(const QString& user, const QString& database) const
{
    return QStringLiteral("postgresql://%1@localhost/%2?host=%3")
        .arg(QString::fromLatin1(QUrl::toPercentEncoding(user)), QString::fromLatin1(QUrl::toPercentEncoding(database)),
             QString::fromLatin1(QUrl::toPercentEncoding(m_dir.path())));
}

QString TestPostgresServer::createDatabase()
{
    const QString name = QStringLiteral("store_%1").arg(++m_databases);
    const QString connection = QStringLiteral("test-server-admin");
    {
        QSqlDatabase admin = QSqlDatabase::addDatabase(QStringLiteral("QPSQL"), connection);
        vemi::PostgresDialect::applyAddress(admin, addressAs(QStringLiteral("postgres"), QStringLiteral("postgres")));
        if (admin.open())
            QSqlQuery(admin).exec(QStringLiteral("CREATE DATABASE ") + name);
        else
            qWarning("TestPostgresServer: %s", qPrintable(admin.lastError().text()));
        admin.close();
    }
    QSqlDatabase::removeDatabase(connection);
    return addressAs(QStringLiteral("postgres"), name);
}
