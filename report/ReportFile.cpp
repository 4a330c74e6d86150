#include "report/ReportFile.h"

#include "platform/PaperDocument.h"
#include "storage/Writing.h"

void writePdf(const PaperDocument& document, const std::string& path, AtomicFile::Existing existing)
{
    const std::string bytes = document.pdf();
    AtomicFile file(path, existing);
    fill(file.stream(), path,
         [&](FILE* stream) { return std::fwrite(bytes.data(), 1, bytes.size(), stream) == bytes.size() ? 0 : -1; });
    file.commit();
}
