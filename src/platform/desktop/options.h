#pragma once

class QRadioButton;

/// Checks one of the options beside each other and makes it the one that Tab reaches. The toolkit
/// does the second only where the option has had the focus: until then Tab stops at the first.
void chooseOption(QRadioButton *option);
