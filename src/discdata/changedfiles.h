#pragma once

class FileJournal;

/// What this run and those before it have changed in files of the user, in the folder "Changes"
/// beside the catalogue.
FileJournal &changedFiles();
