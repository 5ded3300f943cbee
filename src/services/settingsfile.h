#pragma once

#include <QVariant>

/// The settings of the user: a tree of keys, blind to case and to a separator at the end, with
/// named values, each a text, a 32-bit number or bytes. One JSON file, written whole or not at all;
/// one that cannot be read as such is set aside under another name, never overwritten. All errors
/// come back as a result code, 0 for success.
class SettingsFile
{
public:
    explicit SettingsFile(QString file);

    enum Code { Success = 0, NotFound = 2, AccessDenied = 5, BadFormat = 1010 };

    bool hasKey(const QString &key) const;
    Code createKey(const QString &key); // and those above it
    Code deleteKey(const QString &key); // with all that is below it
    Code value(const QString &key, const QString &name, QVariant &value) const;
    Code setValue(const QString &key, const QString &name, const QVariant &value);
    Code deleteValue(const QString &key, const QString &name);

private:
    using Values = QMap<QString, QVariant>;
    using Tree = QMap<QString, Values>;
    Code read(Tree &tree) const;
    template <typename Change> Code change(Change change);

    QString mFile;
};
