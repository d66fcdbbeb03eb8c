#pragma once

#include <QString>
#include <span>

namespace etq::demo {

struct DemoOptions {
    int items = 300;  // at least 1
    quint64 seed = 1;
};

// The host document files of the delivered document database, by WizFileID.
struct DemoDocumentFile {
    int wizFileId;
    const char* baseName;  // file name without ".dbf"
};
inline constexpr DemoDocumentFile kDemoDocumentFiles[] = {
    {1, "dlvnote"}, {2, "invoice"}, {3, "return"},  {4, "orders"},
    {5, "grcpt"},   {6, "purord"},  {12, "transf"},
};

// Writes a host company folder into `dir` (made when missing): oitm, oitg, oitb, opln, ocrn,
// ospp and ocrd, and one stock document file per entry of kDemoDocumentFiles. The same options
// give the same bytes on every run. Throws std::runtime_error when a file cannot be written.
void writeDemoCompany(const QString& dir, const DemoOptions& options = {});

}  // namespace etq::demo
