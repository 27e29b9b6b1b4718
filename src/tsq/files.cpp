#include <algorithm>
#include <climits>
#include <fstream>
#include <memory>
#include <new>
#include <utility>
#include <vector>

#include "base/atomic_file.h"
#include "base/file_access.h"
#include "base/path_parts.h"
#include "tsq/encode.h"
#include "tsq/errors.h"
#include "tsq/memory_store.h"
#include "tsq/open_netcdf.h"
#include "tsq/step_reader.h"
#include "tsq/step_writer.h"
#include "tsq/tsq.h"

namespace ryn {

/// One of the two.
struct TsqFile {
    std::unique_ptr<StepReader> reader;
    std::unique_ptr<StepWriter> writer;
};

void TsqFileDelete::operator()(TsqFile* file) const {
    delete file;
}

namespace {

Status OpenInMemory(const std::string& path, TsqHeader* header,
                    std::unique_ptr<StepSource>* source) {
    MemoryStore::File content = MemoryStore::Instance().Find(path);
    if (!content)
        return Status::FromErrno(path, ENOENT);
    *header = content->header;
    *source = SourceInMemory(std::move(content));
    return Status::Ok();
}

/// Reads every step of a file into memory, in any order of steps: copying judges nothing.
Status Load(const std::string& path, TsqContent* content) {
    std::unique_ptr<StepSource> source;
    if (Status status = OpenNetcdf(path, TimeOrder::Any, &content->header, &source); !status)
        return status;
    const TsqHeader& header = content->header;
    StepReader reader(path, header, std::move(source));
    content->values.resize(header.items.size());
    for (int step = 0; step < header.axis.count; ++step)
        for (std::size_t item = 0; item < header.items.size(); ++item) {
            const std::size_t cells = header.items[item].cells;
            std::vector<float>& values = content->values[item];
            values.resize(values.size() + cells);
            double time = 0.0;
            if (!reader.Next(item == 0 ? &time : nullptr, values.data() + values.size() - cells))
                return reader.Failure();
            if (item == 0 && !header.axis.IsEquidistant())
                content->times.push_back(time);
        }
    return Status::Ok();
}

Status CopyBytes(const std::string& from, const std::string& to) {
    if (!CanOpenForReading(from))
        return Status::SystemFault(from + ": cannot be read");
    std::ifstream input(from, std::ios::binary);
    AtomicFile output;
    if (Status status = output.Open(to); !status)
        return status;
    std::vector<char> block(1 << 20);
    while (input.read(block.data(), static_cast<std::streamsize>(block.size())), input.gcount() > 0)
        output.Write({block.data(), static_cast<std::size_t>(input.gcount())});
    if (input.bad())
        return Status::SystemFault(from + ": cannot be read");
    return output.Commit(Durability::Unflushed);
}

Status CopyToDisk(const TsqContent& content, const std::string& to) {
    AtomicFile output;
    if (Status status = output.Open(to); !status)
        return status;
    if (Status status = EncodeNetcdf(content, output.TemporaryName(), to); !status)
        return status;
    return output.Commit(Durability::Unflushed);
}

int OpenForReading(const std::string& path, TimeOrder order, TsqHeaderHandle* header,
                   TsqFileHandle* file) try {
    TsqHeaderHandle readHeader(new TsqHeader);
    std::unique_ptr<StepSource> source;
    // Memory files are known by their absolute path; disk files keep the name that messages show.
    const std::string full = MemoryStore::Instance().AbsolutePath(path);
    const Status status = MemoryStore::Instance().Covers(full)
                              ? OpenInMemory(full, readHeader.get(), &source)
                              : OpenNetcdf(path, order, readHeader.get(), &source);
    if (!status)
        return FailReading(status);
    TsqFileHandle readFile(new TsqFile);
    readFile->reader = std::make_unique<StepReader>(path, *readHeader, std::move(source));
    *header = std::move(readHeader);
    *file = std::move(readFile);
    return 0;
} catch (const std::bad_alloc&) {
    return FailReading(Status::SystemFault(path + ": not enough memory"));
}

} // namespace

int tsqFileRead(const std::string& path, TsqHeaderHandle* header, TsqFileHandle* file) {
    return OpenForReading(path, TimeOrder::Ascending, header, file);
}

int tsqFileReadUnordered(const std::string& path, TsqHeaderHandle* header, TsqFileHandle* file) {
    return OpenForReading(path, TimeOrder::Any, header, file);
}

bool tsqFileExists(const std::string& path) {
    MemoryStore& store = MemoryStore::Instance();
    const std::string full = store.AbsolutePath(path);
    return store.Covers(full) ? store.Find(full) != nullptr : CanOpenForReading(path);
}

int tsqFindBlockDynamic(TsqHeader* header, TsqFile* file) {
    if (header == nullptr || file == nullptr || !file->reader)
        return FailReading(Status::InputFault("no file is open for reading"));
    file->reader->Rewind();
    return 0;
}

int tsqReadItemTimeStep(TsqHeader* header, TsqFile* file, double* time, float* buffer) try {
    if (header == nullptr || file == nullptr || !file->reader)
        return FailReading(Status::InputFault("no file is open for reading"));
    return file->reader->Next(time, buffer) ? 0 : FailReading(file->reader->Failure());
} catch (const std::bad_alloc&) {
    return FailReading(Status::SystemFault("not enough memory for a block of time steps"));
}

int tsqReadItemBlock(TsqHeader* header, TsqFile* file, int itemNumber, TsqBlock* block) try {
    const TsqItem* const item = tsqItemD(header, itemNumber);
    if (file == nullptr || !file->reader || item == nullptr || tsqGetItemDimensions(item) != 0)
        return FailReading(Status::InputFault("no such plain series in a file open for reading"));
    return file->reader->NextBlock(static_cast<std::size_t>(itemNumber - 1), block)
               ? 0
               : FailReading(file->reader->Failure());
} catch (const std::bad_alloc&) {
    return FailReading(Status::SystemFault("not enough memory for a block of time steps"));
}

int tsqCountMissing(TsqHeader* header, TsqFile* file, int itemNumber, int* missing) try {
    if (file == nullptr || !file->reader || tsqItemD(header, itemNumber) == nullptr)
        return FailReading(Status::InputFault("no such item in a file open for reading"));
    std::size_t found = 0;
    const Status status =
        file->reader->CountMissing(static_cast<std::size_t>(itemNumber - 1), &found);
    if (!status)
        return FailReading(status);
    *missing = static_cast<int>(std::min<std::size_t>(found, INT_MAX));
    return 0;
} catch (const std::bad_alloc&) {
    return FailReading(Status::SystemFault("not enough memory for a block of time steps"));
}

int tsqFileCreate(const std::string& path, TsqHeader* header, TsqFileHandle* file) {
    if (header == nullptr)
        return FailWriting(Status::InputFault(path + ": no header"));
    TsqFileHandle made(new TsqFile);
    if (Status status = StepWriter::Create(path, *header, &made->writer); !status)
        return FailWriting(std::move(status));
    *file = std::move(made);
    return 0;
}

int tsqWriteItemTimeStep(TsqHeader* header, TsqFile* file, double time, const float* values) {
    if (header == nullptr || file == nullptr || !file->writer || values == nullptr)
        return FailWriting(Status::InputFault("no file is open for writing"));
    return file->writer->Append(time, values) ? 0 : FailWriting(file->writer->Failure());
}

int tsqWriteItemBlock(TsqHeader* header, TsqFile* file, const double* times, const float* values,
                      std::size_t count) {
    if (header == nullptr || file == nullptr || !file->writer || (values == nullptr && count != 0))
        return FailWriting(Status::InputFault("no file is open for writing"));
    if (times == nullptr && !tsqGetTimeAxis(header).IsEquidistant())
        return FailWriting(Status::InputFault("the time steps have no times"));
    return file->writer->AppendSteps(times, values, count) ? 0
                                                           : FailWriting(file->writer->Failure());
}

int tsqFileClose(TsqHeader* /*header*/, TsqFileHandle* file) {
    if (file == nullptr || *file == nullptr)
        return 0;
    // The handle is empty from here on, also after a failure: nothing can be saved by closing
    // twice.
    const TsqFileHandle closed = std::move(*file);
    if (!closed->writer)
        return 0;
    Status status = closed->writer->Finish();
    return status ? 0 : FailWriting(std::move(status));
}

Status tsqCopyFile(const std::string& from, const std::string& to) try {
    MemoryStore& store = MemoryStore::Instance();
    const std::string source = store.AbsolutePath(from);
    const std::string target = store.AbsolutePath(to);
    const bool isFromMemory = store.Covers(source);
    const bool isToMemory = store.Covers(target);
    if (!isFromMemory && !isToMemory)
        return CopyBytes(source, target);
    if (!isFromMemory) {
        TsqContent content;
        const Status status = Load(source, &content);
        return status ? store.Put(target, std::move(content)) : status;
    }
    const MemoryStore::File file = store.Find(source);
    if (!file)
        return Status::FromErrno(from, ENOENT);
    return isToMemory ? store.Put(target, file) : CopyToDisk(*file, target);
} catch (const std::bad_alloc&) {
    return Status::SystemFault(from + ": not enough memory to copy it");
}

} // namespace ryn
