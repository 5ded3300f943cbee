#pragma once

#include <QString>
#include <array>

/// The fields of a tag, in the order in which all screens list them.
enum class TagField {
    Album,
    Title,
    CopyrightHolder,
    Comments,
    Label,
    LeadArtist,
    PartOfSet,
    TrackPosition,
    Year,
    Genre,
    FileId
};
inline constexpr int tagFields = 11;

/// One ID3v2 tag in memory: eleven texts, empty where the file has none.
class CddbID3Tag
{
public:
    QString Album() const { return field(TagField::Album); }
    void setAlbum(const QString &text) { setField(TagField::Album, text); }
    QString Title() const { return field(TagField::Title); }
    void setTitle(const QString &text) { setField(TagField::Title, text); }
    QString CopyrightHolder() const { return field(TagField::CopyrightHolder); }
    void setCopyrightHolder(const QString &text) { setField(TagField::CopyrightHolder, text); }
    QString Comments() const { return field(TagField::Comments); }
    void setComments(const QString &text) { setField(TagField::Comments, text); }
    QString Label() const { return field(TagField::Label); }
    void setLabel(const QString &text) { setField(TagField::Label, text); }
    QString LeadArtist() const { return field(TagField::LeadArtist); }
    void setLeadArtist(const QString &text) { setField(TagField::LeadArtist, text); }
    QString PartOfSet() const { return field(TagField::PartOfSet); } // n/m
    void setPartOfSet(const QString &text) { setField(TagField::PartOfSet, text); }
    QString TrackPosition() const { return field(TagField::TrackPosition); }
    void setTrackPosition(const QString &text) { setField(TagField::TrackPosition, text); }
    QString Year() const { return field(TagField::Year); }
    void setYear(const QString &text) { setField(TagField::Year, text); }
    QString Genre() const { return field(TagField::Genre); }
    void setGenre(const QString &text) { setField(TagField::Genre, text); }

    /// Owner and data of a unique file identifier, "owner=hexadecimal": our own where there is one.
    QString FileId() const { return field(TagField::FileId); }
    void setFileId(const QString &text) { setField(TagField::FileId, text); }

    QString field(TagField which) const { return mFields[size_t(which)]; }
    void setField(TagField which, const QString &text) { mFields[size_t(which)] = text; }

    /// Fills the fields from a file's ID3v2 tag (2.2, 2.3, 2.4); without one they become empty.
    /// ID3v1, APE and other tags do not count. Throws Error (errFileFailed) where there is no
    /// ordinary file of this name, or it cannot be opened.
    void LoadFromFile(const QString &path, int flags);

    bool operator==(const CddbID3Tag &) const = default;

private:
    std::array<QString, tagFields> mFields;
};

/// The owner of the file identifiers that the program writes; all others are only read.
extern const char *const ownFileIdOwner;
