#include "discdata/Credits.h"

#include "discdata/ui_Credits.h"
#include "platform/desktop/desktop.h"
#include "services/captions.h"
#include "services/frame.h"
#include "services/messages.h"

using namespace Qt::StringLiterals;

Credits::Credits() : Form(u"Credits"_s)
{
    Ui::Credits ui;
    ui.setupUi(this);
    setDefaultButton(ui.OKButton);
    setCancelButton(ui.OKButton);
    applyCaptions(this, {{"Credits", "xCreditsCaption"},
                         {"lblCredits", "xCreditsText"},
                         {"cmdMusicBrainz", "xCreditsMusicBrainz"},
                         {"cmdCDDB", "xCreditsCDDB"},
                         {"OKButton", "OKButtonCaption"}});
    const auto opens = [this](QPushButton *button, const QString &address) {
        connect(button, &QPushButton::clicked, this, [address] {
            Desktop::current().openAddress(address, [address] { informationBox(address); });
        });
    };
    opens(ui.cmdMusicBrainz, u"https://musicbrainz.org"_s);
    opens(ui.cmdCDDB, u"https://gnudb.org"_s);
    connect(ui.OKButton, &QPushButton::clicked, this, &Form::Unload);
}

void Credits::Form_Load()
{
    placeInFrame(this, 0.3, 0.25);
}
