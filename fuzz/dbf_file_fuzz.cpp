// Fuzz target: a host dBASE file of any bytes, opened as every host reader opens it. A file
// that cannot be read must end in DbfError; anything else (a crash, a read outside the file,
// undefined behaviour, another exception) is a fault. The bytes go through a real file (a
// memory file reopened by its /proc path), so the reader's own open and checks run too.
#include <sys/mman.h>
#include <unistd.h>

#include <QByteArray>
#include <cstddef>
#include <cstdint>
#include <cstdio>
#include <cstdlib>

#include "import/dbf_file.h"
#include "import/host_layouts.h"

namespace h = etq::host;

namespace {

const h::HostLayout* const kLayouts[] = {&h::oitm::kLayout, &h::oitg::kLayout,    &h::oitb::kLayout,
                                         &h::opln::kLayout, &h::ocrn::kLayout,    &h::ospp::kLayout,
                                         &h::ocrd::kLayout, &h::stockdoc::kLayout};

// The memory file the input is written into, and the path that opens it.
struct InputFile {
    InputFile() : fd(::memfd_create("dbf-input", 0)) {
        if (fd < 0) {
            std::perror("memfd_create");
            std::abort();
        }
        path = QStringLiteral("/proc/self/fd/%1").arg(fd);
    }
    void hold(const uint8_t* data, size_t size) const {
        if (::ftruncate(fd, 0) != 0 || ::pwrite(fd, data, size, 0) != ssize_t(size)) std::abort();
    }
    int fd;
    QString path;
};

// Reads every field of every record as the layout's readers take them.
qint64 readEveryField(const etq::DbfFile& file, const h::HostLayout& layout) {
    qint64 sum = 0;
    const QList<h::PlacedField> fields = h::placedFields(layout);
    for (qint64 record = 0; record < file.recordCount(); ++record) {
        sum += file.isDeleted(record);
        sum += file.record(record).size();
        for (const h::PlacedField& field : fields) {
            sum += file.text(record, field.offset, field.width).size();
            sum += file.rawText(record, field.offset, field.width).size();
            sum += file.bytes(record, field.offset, field.width).size();
            if (field.type == 'I') sum += file.int32(record, field.offset);
        }
    }
    return sum;
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size) {
    static const InputFile input;
    input.hold(data, size);
    try {
        const etq::DbfFile file(input.path);
        for (const h::HostLayout* layout : kLayouts) {
            try {
                h::requireLayout(file, *layout);
            } catch (const etq::DbfError&) {
                continue;
            }
            volatile qint64 sum = readEveryField(file, *layout);
            (void)sum;
        }
        for (const etq::DbfField& field : file.fields())
            (void)file.field(field.name);
    } catch (const etq::DbfError&) {
    }
    return 0;
}
