#include "services/clsRegistry.h"

#include "platform/desktop/desktop.h"
#include "services/settingsfile.h"

using namespace Qt::StringLiterals;

namespace
{

constexpr int vbObjectError = int(0x80040000);

SettingsFile store()
{
    return SettingsFile(Desktop::current().settingsFile());
}

void CheckRegResult(int code)
{
    if (code != 0)
        throw Error(vbObjectError + code, u"regFout"_s, u"Settings: code %1"_s.arg(code));
}

} // namespace

QString clsRegistry::inMainKey(const QString &key) const
{
    return QString::number(quint32(MainKey), 16) + u'\\' + key;
}

template <typename Operation>
void clsRegistry::guarded(const char *action, const QString &key, const QString &name,
                          Operation operation)
{
    try {
        operation();
    } catch (Error &error) {
        const bool fromStore = error.Source == "regFout"_L1;
        const bool soft = ysnFailSoftRead && qstrcmp(action, "GetValue") == 0;
        error.Source = u"clsRegistry"_s;
        if (!fromStore)
            emit vbFout(error, error.Source);
        else if (!soft)
            emit regFout(error, error.Source, QLatin1String(action), key, name);
    }
}

QVariant clsRegistry::GetValue(const QString &strKey, const QString &strValName)
{
    QVariant result;
    guarded("GetValue", strKey, strValName, [&] {
        QVariant value;
        CheckRegResult(store().value(inMainKey(strKey), strValName, value));
        if (value.typeId() == QMetaType::QString || value.typeId() == QMetaType::Int)
            result = value;
    });
    return result;
}

void clsRegistry::SetValue(const QString &strKey, const QString &strValName,
                           const QVariant &varValue)
{
    guarded("SetValue", strKey, strValName, [&] {
        auto settings = store();
        if (!settings.hasKey(inMainKey(strKey)))
            CheckRegResult(SettingsFile::NotFound);
        const int type = varValue.typeId();
        if (type == QMetaType::QString || type == QMetaType::Int)
            CheckRegResult(settings.setValue(inMainKey(strKey), strValName, varValue));
    });
}

void clsRegistry::CreateKey(const QString &strKey)
{
    guarded("CreateKey", strKey, {}, [&] { CheckRegResult(store().createKey(inMainKey(strKey))); });
}

void clsRegistry::DeleteKey(const QString &strKey, const QString &strSubKey)
{
    const QString whole = strKey + u'\\' + strSubKey;
    guarded("DeleteKey", whole, {}, [&] { CheckRegResult(store().deleteKey(inMainKey(whole))); });
}

void clsRegistry::DeleteValue(const QString &strKey, const QString &strValName)
{
    guarded("DeleteValue", strKey, strValName,
            [&] { CheckRegResult(store().deleteValue(inMainKey(strKey), strValName)); });
}
