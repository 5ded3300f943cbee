#pragma once

#include "discs/discrecord.h"
#include "platform/desktop/form.h"

#include <memory>

namespace Ui
{
class Candidates;
}

/// Lets the user pick the disc that he has out of those that a service knows: Enter, a double click
/// or OK picks.
class Candidates : public Form
{
    Q_OBJECT

public:
    explicit Candidates(const std::vector<DiscRecord> &candidates);
    ~Candidates() override;

    std::optional<size_t> chosen() const { return mChosen; } // place in the candidates

protected:
    void Form_Load() override;
    void Form_Activate() override;

private:
    void fillList(const std::vector<DiscRecord> &candidates);
    void choose();

    std::unique_ptr<Ui::Candidates> mUi;
    std::optional<size_t> mChosen;
};
