#pragma once

class QWidget;

// The entries of the menu that speak of the services, each with a session of its own.

/// mnuRegisterCDDB: the user's sign-up, to be changed at any time.
void registerAtServices(QWidget *owner);

/// mnuOverCDDB: where the data come from.
void showCredits(QWidget *owner);
