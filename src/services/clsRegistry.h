#pragma once

#include "platform/error/error.h"

#include <QObject>
#include <QVariant>

/// The key of all settings of the program, as reads name it and as writes do.
inline constexpr QLatin1String settingsReadKey("Software\\Orvanta Software\\SongCase\\");
inline constexpr QLatin1String settingsKey("Software\\Orvanta Software\\SongCase");

/// The store of settings: a caller makes an object, uses it, drops it. No operation ever fails
/// towards its caller; what goes wrong is told by the two signals alone, and a value that cannot be
/// read is an invalid QVariant.
class clsRegistry : public QObject
{
    Q_OBJECT

public:
    static constexpr int HKEY_LOCAL_MACHINE = int(0x80000002);

    bool ysnFailSoftRead = false;     // no regFout for a value that cannot be read
    int MainKey = HKEY_LOCAL_MACHINE; // each main key has a tree of its own

    QVariant GetValue(const QString &strKey, const QString &strValName);

    /// The key must exist. Only a QString and an int are stored; any other type does nothing.
    void SetValue(const QString &strKey, const QString &strValName, const QVariant &varValue);
    void CreateKey(const QString &strKey);
    void DeleteKey(const QString &strKey, const QString &strSubKey);
    void DeleteValue(const QString &strKey, const QString &strValName);

signals:
    void vbFout(const Error &error, const QString &source);
    void regFout(const Error &error, const QString &source, const QString &Action,
                 const QString &key, const QString &Valname);

private:
    QString inMainKey(const QString &key) const;
    template <typename Operation>
    void guarded(const char *action, const QString &key, const QString &name, Operation operation);
};
