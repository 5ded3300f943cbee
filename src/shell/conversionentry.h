#pragma once

class MainScreen;

/// The entry of the menu that takes an old catalogue over.
void connectConversionEntry(MainScreen &frame);

/// The same, unasked, at the first activation of the frame after an upgrade. Nothing happens while
/// no catalogue is open: there is nowhere to take an old one over to.
void offerConversion(bool &pending);
