#pragma once

class QComboBox;

/// A wheel that passes over a list of choices turns what is around it, and changes nothing in the
/// list, unless that has the focus. A wheel does not give it.
void ignorePassingWheel(QComboBox *list);
