#include "services/settingsfile.h"

#include "platform/desktop/desktop.h"
#include "services/wholefile.h"

#include <QDir>
#include <QFileInfo>
#include <QJsonDocument>
#include <QJsonObject>
#include <QLockFile>
#include <QSaveFile>

using namespace Qt::StringLiterals;

namespace
{

QString normalKey(const QString &key)
{
    return key.toLower().split(u'\\', Qt::SkipEmptyParts).join(u'\\');
}

QVariant fromJson(const QJsonObject &o)
{
    const QString type = o.value("type"_L1).toString();
    const QJsonValue v = o.value("value"_L1);
    if (type == "text"_L1)
        return v.toString();
    if (type == "number"_L1)
        return v.toInt();
    return QByteArray::fromBase64(v.toString().toLatin1());
}

QJsonObject toJson(const QVariant &v)
{
    const auto object = [](const char *type, const QJsonValue &value) {
        return QJsonObject{{u"type"_s, QLatin1String(type)}, {u"value"_s, value}};
    };
    switch (v.typeId()) {
    case QMetaType::QString:
        return object("text", v.toString());
    case QMetaType::Int:
        return object("number", v.toInt());
    default:
        return object("binary", QString::fromLatin1(v.toByteArray().toBase64()));
    }
}

bool setAside(const QString &file)
{
    const QString stamp = Desktop::current().now().toString(u"yyyyMMdd-hhmmss"_s);
    QString aside = file + u".damaged-"_s + stamp;
    while (QFile::exists(aside))
        aside += u'x';
    return QFile::rename(file, aside);
}

} // namespace

SettingsFile::SettingsFile(QString file) : mFile(std::move(file)) {}

// No file is an empty tree; one that is there but cannot be read must never be taken for that.
SettingsFile::Code SettingsFile::read(Tree &tree) const
{
    QFile file(mFile);
    if (!file.open(QIODevice::ReadOnly))
        return QFileInfo::exists(mFile) ? AccessDenied : Success;
    const QJsonDocument document = QJsonDocument::fromJson(file.readAll());
    const bool wholly = file.error() == QFileDevice::NoError;
    file.close();
    if (!wholly)
        return AccessDenied;
    if (!document.isObject())
        return setAside(mFile) ? Success : BadFormat;
    const QJsonObject keys = document.object();
    for (auto key = keys.begin(); key != keys.end(); ++key) {
        Values &values = tree[normalKey(key.key())];
        const QJsonObject named = key.value().toObject();
        for (auto v = named.begin(); v != named.end(); ++v)
            values[v.key().toLower()] = fromJson(v.value().toObject());
    }
    return Success;
}

template <typename Change> SettingsFile::Code SettingsFile::change(Change change)
{
    if (!QDir().mkpath(QFileInfo(mFile).absolutePath()))
        return AccessDenied;
    QLockFile lock(mFile + u".lock"_s);
    if (!lock.tryLock(2000))
        return AccessDenied;
    Tree tree;
    if (const Code code = read(tree); code != Success)
        return code;
    if (const Code code = change(tree); code != Success)
        return code;
    QJsonObject keys;
    for (auto key = tree.cbegin(); key != tree.cend(); ++key) {
        QJsonObject named;
        for (auto v = key->cbegin(); v != key->cend(); ++v)
            named.insert(v.key(), toJson(v.value()));
        keys.insert(key.key(), named);
    }
    QSaveFile file(mFile);
    if (!file.open(QIODevice::WriteOnly))
        return AccessDenied;
    file.setPermissions(QFile::ReadOwner | QFile::WriteOwner); // it may hold a password
    file.write(QJsonDocument(keys).toJson());
    return commitWhole(file) ? Success : AccessDenied;
}

bool SettingsFile::hasKey(const QString &key) const
{
    Tree tree;
    return read(tree) == Success && tree.contains(normalKey(key));
}

SettingsFile::Code SettingsFile::createKey(const QString &key)
{
    return change([&](Tree &tree) {
        const QString normal = normalKey(key);
        for (auto end = normal.indexOf(u'\\'); end >= 0; end = normal.indexOf(u'\\', end + 1))
            tree[normal.left(end)];
        tree[normal];
        return Success;
    });
}

SettingsFile::Code SettingsFile::deleteKey(const QString &key)
{
    return change([&](Tree &tree) {
        const QString normal = normalKey(key), below = normal + u'\\';
        const auto removed = tree.removeIf(
            [&](Tree::iterator it) { return it.key() == normal || it.key().startsWith(below); });
        return removed > 0 ? Success : NotFound;
    });
}

SettingsFile::Code SettingsFile::value(const QString &key, const QString &name,
                                       QVariant &value) const
{
    Tree tree;
    if (const Code code = read(tree); code != Success)
        return code;
    const auto it = tree.constFind(normalKey(key));
    if (it == tree.cend() || !it->contains(name.toLower()))
        return NotFound;
    value = it->value(name.toLower());
    return Success;
}

SettingsFile::Code SettingsFile::setValue(const QString &key, const QString &name,
                                          const QVariant &value)
{
    return change([&](Tree &tree) {
        const auto it = tree.find(normalKey(key));
        if (it == tree.end())
            return NotFound;
        it->insert(name.toLower(), value);
        return Success;
    });
}

SettingsFile::Code SettingsFile::deleteValue(const QString &key, const QString &name)
{
    return change([&](Tree &tree) {
        const auto it = tree.find(normalKey(key));
        if (it == tree.end() || it->remove(name.toLower()) == 0)
            return NotFound;
        return Success;
    });
}
