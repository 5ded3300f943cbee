#pragma once

#include <QString>
#include <QStringList>
#include <concepts>

// Tests write a text as u"text"_s.
using namespace Qt::StringLiterals;

/// A parameter that takes any text, a plain literal as well, which is UTF-8.
class AnyText : public QString
{
public:
    AnyText(const char *utf8) : QString(QString::fromUtf8(utf8)) {}
    template <typename Text>
    requires std::convertible_to<Text, QString> AnyText(const Text &text) : QString(text) {}
};

template <typename T> struct GivenAs {
    using Type = T;
};
template <> struct GivenAs<QString> {
    using Type = AnyText;
};

/// What a caller may write for a T.
template <typename T> using Given = typename GivenAs<T>::Type;

/// A list of texts, given as UTF-8.
template <typename... Text> QStringList texts(Text... text)
{
    return {QString::fromUtf8(text)...};
}
