#pragma once

/// The highest number of a disc of one record that is read from a file and shown in an editor. No
/// record of a person comes near; a file or a catalogue that says more was made to do harm.
inline constexpr int highestDisc = 9999;
