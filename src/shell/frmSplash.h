#pragma once

#include "platform/desktop/form.h"

#include <memory>

namespace Ui
{
class frmSplash;
}

/// The picture at the start, and the About screen. A key or a click closes it.
class frmSplash : public Form
{
    Q_OBJECT

public:
    frmSplash();
    ~frmSplash() override;

    void setAuthor(const QString &text);

    /// Handles events until the picture is on the screen, for a fraction of a second at the most.
    void waitUntilPainted();

protected:
    void Form_Load() override;
    void keyPressEvent(QKeyEvent *event) override;

private:
    void showWords();

    std::unique_ptr<Ui::frmSplash> mUi;
};
