#pragma once

class Form;

/// Shows a form as a modal window of its own and returns when it is hidden, unloaded or gone. The
/// last step of every desktop's showModal.
void runModal(Form &form);

/// Ends the box, dialog or modal screen on top of all others in the way that changes least: a box
/// by Cancel, else No, else OK; a screen is unloaded. For an end of the program that nobody is
/// there to agree to.
void refuseModal();

/// Whether the last box to close was ended so.
bool modalWasRefused();
void setModalAnswered(); // to be called before each box
