#pragma once

#include <QLabel>
#include <vector>

/// Stands in an empty list of the browser and says what to do: for each step that the menu has an
/// entry for, and that can be taken now, a link that does what the entry does, with its key and the
/// picture of its button.
class FirstSteps : public QLabel
{
    Q_OBJECT

public:
    struct Step {
        const char *words; // key
        const char *command;
    };

    explicit FirstSteps(QWidget *parent = nullptr);

    /// Shows itself in place of an empty list. `head` is the key of what is said above the steps.
    void showFor(bool empty, const char *head, const std::vector<Step> &steps);
};
