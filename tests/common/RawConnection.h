#pragma once

#include <QString>
#include <QVariant>
#include <QVariantList>

// A second connection to a store (a file or a postgresql:// address), as
// another program would open it:
// lets a test damage, lock or inspect the file behind the store's back.
class RawConnection
{
public:
    explicit RawConnection(const QString& path);
    RawConnection(const RawConnection&) = delete;
    RawConnection& operator=(const RawConnection&) = delete;
    ~RawConnection();

    bool exec(const QString& sql, const QVariantList& bindings = {});
    QVariant scalar(const QString& sql);

private:
    QString m_name;
};
