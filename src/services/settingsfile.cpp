#include "services/settingsfile.h"

#include "platform/desktop/desktop.h"
#include "platform/files/filelock.h"
#include "platform/files/wholefile.h"

#include <QDir>
#include <QFileInfo>
#include <QJsonDocument>
#include <QJsonObject>

using namespace Qt::StringLiterals;

namespace
{

constexpr int otherWriterAtMost = 2000; // milliseconds

QString normalKey(const QString &key)
{
    return key.toLower().split(u'\\', Qt::SkipEmptyParts).join(u'\\');
}

// A value of ours as what it is; any other as it stands, so that it stays when others change.
QVariant fromJson(const QJsonValue &value)
{
    const QString type = value["type"_L1].toString();
    const QJsonValue v = value["value"_L1];
    if (type == "text"_L1 && v.isString())
        return v.toString();
    if (type == "number"_L1 && v == v.toInt())
        return v.toInt();
    if (type == "binary"_L1 && v.isString())
        return QByteArray::fromBase64(v.toString().toLatin1());
    return value;
}

QJsonValue toJson(const QVariant &v)
{
    const auto object = [](const char *type, const QJsonValue &value) {
        return QJsonObject{{u"type"_s, QLatin1String(type)}, {u"value"_s, value}};
    };
    switch (v.typeId()) {
    case QMetaType::QString:
        return object("text", v.toString());
    case QMetaType::Int:
        return object("number", v.toInt());
    case QMetaType::QByteArray:
        return object("binary", QString::fromLatin1(v.toByteArray().toBase64()));
    default:
        return v.toJsonValue();
    }
}

// Whether a document is one of ours: keys, and in them values that are, but for some that a person
// has typed.
bool isOurs(const QJsonDocument &document)
{
    int ours = 0, others = 0;
    const QJsonObject keys = document.object();
    for (const auto &key : keys) {
        const QJsonObject values = key.toObject();
        for (const auto &value : values)
            ++(fromJson(value).typeId() == QMetaType::QJsonValue ? others : ours);
        if (!key.isObject())
            return false;
    }
    return document.isObject() && (ours > 0 || others == 0);
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
    if (!isOurs(document))
        return setAside(mFile) ? Success : BadFormat;
    const QJsonObject keys = document.object();
    for (auto key = keys.begin(); key != keys.end(); ++key) {
        Values &values = tree[normalKey(key.key())];
        const QJsonObject named = key.value().toObject();
        for (auto v = named.begin(); v != named.end(); ++v)
            values[v.key().toLower()] = fromJson(v.value());
    }
    return Success;
}

template <typename Change> SettingsFile::Code SettingsFile::change(Change change)
{
    if (!QDir().mkpath(QFileInfo(mFile).absolutePath()))
        return AccessDenied;
    FileLock lock;
    if (lock.takeWithin(mFile + u".lock"_s, otherWriterAtMost) != FileLock::Outcome::Taken)
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
    WholeFile file(mFile);
    if (!file.open(QIODevice::WriteOnly))
        return AccessDenied;
    file.setPermissions(QFile::ReadOwner | QFile::WriteOwner); // it may hold a password
    file.write(QJsonDocument(keys).toJson());
    return file.commit() ? Success : AccessDenied;
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
