#pragma once

#include "discs/discrecord.h"

#include <optional>

/// What services have answered, kept for the day when none can be reached: a file for each answer,
/// in a folder of its own. It is a comfort and never in the way: what cannot be written is not
/// kept, what is damaged counts as absent.
class KeptAnswers
{
public:
    struct Answer {
        std::vector<DiscRecord> records; // never empty
        QDate date;                      // on which the service gave it
    };

    /// `folder` is made when it is needed; empty: nothing is kept. Of more answers than `most` the
    /// oldest go.
    explicit KeptAnswers(const QString &folder, int most = 2000) : mFolder(folder), mMost(most) {}

    /// A question is any text that says who was asked what. A later answer takes the place of an
    /// earlier one; an empty one is not kept.
    void keep(const QString &question, const std::vector<DiscRecord> &records) const;
    std::optional<Answer> find(const QString &question) const;

private:
    QString fileFor(const QString &question) const;
    void dropOldest() const;

    QString mFolder;
    int mMost;
};
