#include "shell/services/messagetable.h"

#include <iterator>

// Texts for what the fixed table does not know: names for screen readers, messages about files and
// second starts. Keys begin with a small "x", so that none can be taken for a fixed one.

namespace messagetable
{

// clang-format off
const Message furtherTexts[] = {
    {"xInUse", "This catalogue is in use by another program or another user.", "Deze database is in gebruik bij een ander programma of een andere gebruiker."},
    {"xNotACatalogue", "The file is not a catalogue of this program.", "Het bestand is geen database van dit programma."},
    {"xTablesMissing", "The file is not a complete catalogue: a table is missing.", "Het bestand is geen volledige database: er ontbreekt een tabel."},
    {"xDamaged", "The catalogue is damaged. Please put back your last copy of it.", "De database is beschadigd. Zet uw laatste kopie ervan terug."},
    {"xReadOnly", "The catalogue or its folder is read-only.", "De database of de map ervan is alleen-lezen."},
    {"xNewerCatalogue", "The catalogue was made by a newer version of this program.", "De database is gemaakt met een nieuwere versie van dit programma."},
    {"xCannotMakeCatalogue", "The folder for the catalogue cannot be made: ", "De map voor de database kan niet worden gemaakt: "},
    {"xTextFiles", "Text files (*.txt);;All files (*)", "Tekstbestanden (*.txt);;Alle bestanden (*)"},
    {"xProgress", "Progress", "Voortgang"},
    {"xTracksRead", "Tracks to be imported", "Te importeren tracks"},
    {"xGuide", "The guide to Songcase", "De gids van Liedkist"},
    {"xToolbar", "Toolbar", "Werkbalk"},
    {"xDiscs", "Discs", "Discs"},
    {"xOtherRecord", "This disc has been deleted meanwhile, and another one has taken its place in the catalogue. Nothing was saved.", "Deze CD is intussen verwijderd en een andere heeft zijn plaats in de database ingenomen. Er is niets opgeslagen."},
    {"xPrint", "Print list", "Lijst afdrukken"},
    {"xExport", "E&xport...", "E&xporteren..."},
    {"xExportTitle", "Export the list", "Lijst exporteren"},
    {"xExporting", "Exporting: ", "Bezig met exporteren: "},
    {"xExported", "Exported to ", "Geëxporteerd naar "},
    {"xExportCancelled", "The export was cancelled; nothing was written.", "Het exporteren is afgebroken; er is niets geschreven."},
    {"xNotExported", "The file could not be written: ", "Het bestand kon niet worden geschreven: "},
    {"xFoundTracks", "Tracks found", "Gevonden tracks"},
    {"xTrackGone", "This track has been changed or removed since the search. Please search again.", "Deze track is na het zoeken gewijzigd of verwijderd. Zoek opnieuw."},
    {"xTracks", "Tracks of the disc", "Tracks van de disc"},
    {"xSuggestions", "Suggestions", "Suggesties"},
    {"xShowList", "Show the list", "Lijst tonen"},
    {"xNoTrackArtist", "please fill in the artist!", "vul de artiest in!"},
    {"xNoTrackTitle", "please fill in the title!", "vul de titel in!"},
    {"xNoTrackArtistAndTitle", "please fill in artist and title!", "vul artiest en titel in!"},
    {"xTitleGone", "The record of these tracks is no longer in the catalogue, or has no artist.", "Het record van deze tracks staat niet meer in de database, of heeft geen artiest."},
    {"xKeptValues", "These tracks are held by other discs too, or more than once by this one. The catalogue keeps their genre, year and spelling:", "Deze tracks staan ook op andere discs, of meer dan eens op deze. De database houdt hun genre, jaar en schrijfwijze:"},
    {"xKeptArtists", "Artists are never renamed. The catalogue keeps the spelling of the artist of these tracks:", "Artiesten worden nooit hernoemd. De database houdt de schrijfwijze van de artiest van deze tracks:"},
    {"xReportPrint", "P&rint...", "Af&drukken..."},
    {"xReportPdf", "P&DF...", "&PDF..."},
    {"xReportPdfTip", "Save as PDF", "Opslaan als PDF"},
    {"xReportSetup", "Page se&t-up...", "Pagina-i&nstelling..."},
    {"xReportSetupTip", "Page set-up", "Pagina-instelling"},
    {"xReportPageField", "Pa&ge", "Pa&gina"},
    {"xReportPage", "Page ", "Pagina "},
    {"xReportOf", " of ", " van "},
    {"xReportLines", "Number of lines: ", "Aantal regels: "},
    {"xReportBusy", "The pages are being written...", "De pagina's worden geschreven..."},
    {"xReportDone", "Pages written: ", "Geschreven pagina's: "},
    {"xPdfStopped", "Nothing has been written.", "Er is niets geschreven."},
    {"xBusy", "A list is still being written. Please wait until it is done, or cancel it first.", "Er wordt nog een lijst geschreven. Wacht tot dit klaar is of breek het eerst af."},
    {"xReportStopped", "Not all pages have been written.", "Niet alle pagina's zijn geschreven."},
    {"xPreview", "Preview", "Afdrukvoorbeeld"},
    {"xZoom", "Zoom", "Zoom"},
    {"xZoomIn", "Zoom in (Ctrl++)", "Inzoomen (Ctrl++)"},
    {"xZoomOut", "Zoom out (Ctrl+-)", "Uitzoomen (Ctrl+-)"},
    {"xFitWidth", "Fit width", "Paginabreedte"},
    {"xWholePage", "Whole page", "Hele pagina"},
    {"xFirstPage", "First page (Ctrl+Home)", "Eerste pagina (Ctrl+Home)"},
    {"xPreviousPage", "Previous page (Ctrl+Page Up)", "Vorige pagina (Ctrl+Page Up)"},
    {"xNextPage", "Next page (Ctrl+Page Down)", "Volgende pagina (Ctrl+Page Down)"},
    {"xLastPage", "Last page (Ctrl+End)", "Laatste pagina (Ctrl+End)"},
    {"xClose", "&Close", "&Sluiten"},
    {"xPdfFiles", "PDF files (*.pdf);;All files (*)", "PDF-bestanden (*.pdf);;Alle bestanden (*)"},
    {"xPdfFailed", "The PDF file cannot be written: ", "Het PDF-bestand kan niet worden geschreven: "},
    {"xPrintFailed", "The printer cannot be used, or has failed.", "De printer kan niet worden gebruikt, of is gestoord."},
    {"xNoPrinter", "There is no printer on this computer. Would you like to save the list as a PDF file instead?", "Er is geen printer op deze computer. Wilt u de lijst in plaats daarvan als PDF-bestand opslaan?"},
    {"xPaper", "&Paper", "&Papier"},
    {"xOrientation", "Orientation", "Stand"},
    {"xPortrait", "Portra&it", "&Staand"},
    {"xLandscape", "&Landscape", "&Liggend"},
    {"xMargins", "Margins", "Marges"},
    {"xMarginLeft", "L&eft", "L&inks"},
    {"xMarginRight", "&Right", "&Rechts"},
    {"xMarginTop", "&Top", "&Boven"},
    {"xMarginBottom", "&Bottom", "On&der"},
};
// clang-format on

const std::size_t furtherTextCount = std::size(furtherTexts);

} // namespace messagetable
