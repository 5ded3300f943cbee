#pragma once

#include <QObject>

/// Tells a person who comes back to the program that the catalogue was moved, replaced or deleted
/// meanwhile: once, and again only if it was there in between. What is written before that is
/// refused by the connection itself.
class CatalogueWatch : public QObject
{
    Q_OBJECT

public:
    explicit CatalogueWatch(QObject *parent);

private:
    void look();

    bool mTold = false;
};
