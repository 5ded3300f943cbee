#pragma once

#include <QString>

/// Which disc of how many: what a title and the notes on a disc say of it.
struct PartOfSet {
    QString number = QStringLiteral("1"), total = QStringLiteral("1");
    QString title; // without that remark, where the remark says nothing else
};

/// "Title (Disc 2 of 3)", "Title [CD 2]", "Title, Disc 2: Name" and the like, in English, Dutch,
/// German and French; 1 of 1 where nothing is said. A number without a total is its own total.
PartOfSet partOfSet(const QString &title, const QString &notes);
