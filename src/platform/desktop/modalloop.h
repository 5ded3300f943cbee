#pragma once

class Form;

/// Shows a form as a modal window of its own and returns when it is hidden, unloaded or gone. The
/// last step of every desktop's showModal.
void runModal(Form &form);
