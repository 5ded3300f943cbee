#pragma once

#include "discs/discrecord.h"
#include "platform/desktop/form.h"

#include <memory>

namespace Ui
{
class SearchByWords;
}

/// Asks for the words that a disc is searched by where no table of contents is at hand.
class SearchByWords : public Form
{
    Q_OBJECT

public:
    SearchByWords();
    ~SearchByWords() override;

    const SearchWords &words() const { return mWords; } // empty: cancelled

protected:
    void Form_Load() override;

private:
    SearchWords typed() const;
    void OKButton_Click();

    std::unique_ptr<Ui::SearchByWords> mUi;
    SearchWords mWords;
};
