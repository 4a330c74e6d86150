#pragma once

#include "storage/AtomicFile.h"

#include <string>

class PaperDocument;

/// Writes the document as a PDF file, whole or not at all. Throws as an `AtomicFile` does.
void writePdf(const PaperDocument& document, const std::string& path, AtomicFile::Existing existing);
