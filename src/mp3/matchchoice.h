#pragma once

#include <QString>

// What was chosen last on frmMatchWithSongcase. It remains when the form is gone.
extern qint64 gMatchCDId;    // in CDTitels
extern qint64 gMatchDiscNo;  // diskno
extern qint64 gMatchTrackNo; // 0 if a disc was chosen
extern bool gMatchChosen;    // whether the others are of the last showing

/// The nodes of the tree are told apart by their keys, and a key carries the choice:
/// "CD" id "Discno" disc, of a track "Trackno" number behind it.
namespace matchkey
{

extern const QString root;

QString ofDisc(qint64 cdId, qint64 discNo);
QString ofTrack(const QString &discKey, qint64 trackNo);

/// Cuts the last such mark and what stands behind it off a key; gives the number behind it, 0 where
/// there is none.
qint64 takeNumber(QString &key, const QString &mark);

} // namespace matchkey
