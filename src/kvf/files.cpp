#include <filesystem>
#include <mutex>
#include <new>
#include <optional>
#include <system_error>
#include <utility>

#include "base/atomic_file.h"
#include "base/file_access.h"
#include "kvf/kvf.h"
#include "kvf/text_reader.h"
#include "kvf/text_writer.h"
#include "kvf/tree.h"

namespace ryn {

namespace {

/// What kvfPeekErrorGlb gives.
enum LoadError { kNoError = 0, kUnreadable = 1, kSyntaxError = 2 };

constexpr const char* kSizeLimitText = "256 MiB";

struct LoadFailure {
    LoadError error = kNoError;
    KvfSyntaxError place;
};

/// The process's error state. The lock keeps it whole where workers save their own files.
struct ErrorState {
    std::mutex mutex;
    LoadFailure load;
    Status write;
};

ErrorState& Errors() {
    static ErrorState state;
    return state;
}

void SetLoadFailure(LoadFailure failure) {
    ErrorState& state = Errors();
    const std::lock_guard lock(state.mutex);
    state.load = std::move(failure);
}

KvfHandle FailLoad(LoadError error, KvfSyntaxError place) {
    SetLoadFailure({error, std::move(place)});
    return nullptr;
}

Status OutOfMemory(const std::string& path) {
    return Status::SystemFault(path + ": not enough memory");
}

/// Devices and pipes are refused: they would be waited for, or never end.
Status ReadText(const std::string& path, std::string* text) {
    namespace fs = std::filesystem;
    std::error_code error;
    const fs::file_status status = fs::status(path, error);
    if (fs::is_other(status))
        return Status::InputFault(path + ": not a regular file");
    if (fs::is_regular_file(status) && fs::file_size(path, error) > kKvfMaxFileSize && !error)
        return Status::InputFault(path + ": the file is larger than " + kSizeLimitText);
    return ReadWholeFile(path, kKvfMaxFileSize, text); // which knows the other reasons
}

/// Appends a tree's text, which has to be one that a load takes.
Status AppendText(const KvfTree* tree, const std::string& path, std::string* text) {
    if (tree == nullptr)
        return Status::SystemFault(path + ": there is nothing to write");
    KvfTextWriter writer(std::move(*text));
    kvfVisit(tree, writer);
    *text = writer.TakeText();
    if (writer.Depth() > kKvfMaxDepth)
        return Status::SystemFault(path + ": " + std::to_string(writer.Depth()) +
                                   " levels of blocks are more than the format's " +
                                   std::to_string(kKvfMaxDepth));
    if (text->size() > kKvfMaxFileSize)
        return Status::SystemFault(path + ": the file would be larger than " + kSizeLimitText);
    return Status::Ok();
}

enum class WriteMode { Replace, Append };

Status Save(const KvfTree* tree, const std::string& path, WriteMode mode, Durability durability) {
    std::string text;
    if (mode == WriteMode::Append) {
        if (Status status = ReadText(path, &text); !status)
            return status;
        if (!text.empty() && text.back() != '\n')
            text += '\n';
    }
    if (Status status = AppendText(tree, path, &text); !status)
        return status;
    return WriteFileAtomically(path, text, durability);
}

Status SaveAndRemember(const KvfTree* tree, const std::string& path, WriteMode mode,
                       Durability durability) {
    Status status;
    try {
        status = Save(tree, path, mode, durability);
    } catch (const std::bad_alloc&) {
        status = OutOfMemory(path);
    }
    ErrorState& state = Errors();
    const std::lock_guard lock(state.mutex);
    if (state.write.IsOk())
        state.write = status;
    return status;
}

} // namespace

Status kvfWrite(const KvfTree* tree, const std::string& path, Durability durability) {
    return SaveAndRemember(tree, path, WriteMode::Replace, durability);
}

Status kvfAppend(const KvfTree* tree, const std::string& path, Durability durability) {
    return SaveAndRemember(tree, path, WriteMode::Append, durability);
}

Status kvfTakeWriteError() {
    ErrorState& state = Errors();
    const std::lock_guard lock(state.mutex);
    return std::exchange(state.write, Status::Ok());
}

KvfHandle kvfLoadFile(const std::string& path, int) {
    try {
        std::string text;
        if (const Status status = ReadText(path, &text); !status)
            return FailLoad(kUnreadable, {0, 0, status.Text()});
        return kvfLoadText(text, path);
    } catch (const std::bad_alloc&) {
        return FailLoad(kUnreadable, {0, 0, OutOfMemory(path).Text()});
    }
}

KvfHandle kvfLoadText(std::string_view text, const std::string& name) {
    if (text.size() > kKvfMaxFileSize)
        return FailLoad(kUnreadable, {0, 0, name + ": the text is larger than " + kSizeLimitText});
    try {
        KvfHandle tree = kvfCreate();
        std::optional<KvfSyntaxError> error = KvfReadText(text, tree.get());
        if (error) {
            error->text = name + ":" + std::to_string(error->line) + ":" +
                          std::to_string(error->column) + ": " + error->text;
            return FailLoad(kSyntaxError, *std::move(error));
        }
        SetLoadFailure({});
        return tree;
    } catch (const std::bad_alloc&) {
        return FailLoad(kUnreadable, {0, 0, OutOfMemory(name).Text()});
    }
}

int kvfPeekErrorGlb() {
    ErrorState& state = Errors();
    const std::lock_guard lock(state.mutex);
    return state.load.error;
}

int kvfGetErrorGlb() {
    ErrorState& state = Errors();
    const std::lock_guard lock(state.mutex);
    return std::exchange(state.load.error, kNoError);
}

void kvfGetSyntaxErr(const KvfTree*, int* line, int* column, std::string* text) {
    ErrorState& state = Errors();
    const std::lock_guard lock(state.mutex);
    const KvfSyntaxError& place = state.load.place;
    if (line != nullptr)
        *line = place.line;
    if (column != nullptr)
        *column = place.column;
    if (text != nullptr)
        *text = place.text;
}

} // namespace ryn
