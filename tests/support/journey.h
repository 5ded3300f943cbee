#pragma once

#include "services/globals.h"
#include "services/messages.h"
#include "support/datarows.h"
#include "support/program.h"
#include "support/testcatalogue.h"

#include <memory>

/// A person's way through the whole program, on an empty catalogue.
class Journey : public QObject
{
    Q_OBJECT

protected slots:
    void cleanup(); // ends the program

protected:
    /// A data column "language" with both.
    static void languages();

    /// Starts the program in a language, the browser open.
    void start(int language);

    /// The texts of a column of one of the browser's lists.
    QStringList column(const char *list, int n) const;

    std::unique_ptr<ScriptedDesktop> mDesktop;
    std::unique_ptr<Program> mProgram;
};
