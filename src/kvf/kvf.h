#pragma once

#include <initializer_list>
#include <memory>
#include <string>
#include <string_view>

#include "base/atomic_file.h"
#include "base/status.h"

/// The store of parameter and result files: a tree of targets, sections, keywords and parameters,
/// built and walked through these operations. docs/formats/kvf.md describes the text.
///
/// A file holds targets; a target holds sections; a section holds sections and keywords in the
/// order of adding; a keyword holds parameters: int, float, double, bool, text or file name. One
/// name can occur several times at a level, so lookups take a name and an occurrence number.
/// Occurrences and indices count from 1. A null handle finds nothing in every lookup, and every add
/// on one does nothing.
///
/// Handles to parts of a tree are owned by the tree and valid until it is closed. A tree belongs to
/// one thread at a time, also for lookups, which build indices on their first use.
namespace ryn {

class KvfTree;
struct KvfSection; ///< a target or a section
struct KvfKeyword;
struct KvfParam;

struct KvfTreeDelete {
    void operator()(KvfTree* tree) const;
};
using KvfHandle = std::unique_ptr<KvfTree, KvfTreeDelete>;

// Building. The tree has a cursor: each add goes to the innermost open target or section, and each
// parameter to the keyword that kvfAddKeyword started there last. With nothing open an add does
// nothing. Names and texts may hold any bytes; they come back from a file unchanged.

KvfHandle kvfCreate();
/// Opens a target (closing what is still open) and returns it.
KvfSection* kvfAddTarget(KvfTree* tree, std::string_view name);
KvfSection* kvfAddSection(KvfTree* tree, std::string_view name);
/// Closes the innermost open section or target.
void kvfEndSection(KvfTree* tree);
/// Starts a keyword without parameters; kvfAddInt and the others append to it.
void kvfAddKeyword(KvfTree* tree, std::string_view name);
void kvfAddInt(KvfTree* tree, int value);
void kvfAddFloat(KvfTree* tree, float value);
void kvfAddDouble(KvfTree* tree, double value);
void kvfAddBool(KvfTree* tree, bool value);
/// Adds a whole keyword with this one parameter; repeated calls with one name add repeated
/// keywords.
void kvfPutParam(KvfTree* tree, std::string_view keyword, int value);
void kvfPutParam(KvfTree* tree, std::string_view keyword, bool value);
void kvfPutParam(KvfTree* tree, std::string_view keyword, float value);
void kvfPutParam(KvfTree* tree, std::string_view keyword, double value);
void kvfPutParam(KvfTree* tree, std::string_view keyword, std::string_view value);
void kvfPutParam(KvfTree* tree, std::string_view keyword, const char* value);
void kvfPutParamFilename(KvfTree* tree, std::string_view keyword, std::string_view value);
/// One parameter for each letter of `format`; the only letter is 'i'. A format that does not fit
/// the values adds nothing.
void kvfPutListParam(KvfTree* tree, std::string_view keyword, std::string_view format,
                     std::initializer_list<int> values);

/// Writes the tree as a new file, replacing what was there. A tree beyond the format's limits (200
/// levels, 256 MiB of text), which no load would take, is a failure. The first failure since the
/// last kvfTakeWriteError is kept for it.
Status kvfWrite(const KvfTree* tree, const std::string& path,
                Durability durability = Durability::Flushed);
/// Appends the tree's targets to an existing file, whole or not at all; a missing file is a
/// failure. The old content is kept as it is and not looked into.
Status kvfAppend(const KvfTree* tree, const std::string& path,
                 Durability durability = Durability::Flushed);
/// The first write failure since the last call; Ok when there was none.
Status kvfTakeWriteError();
/// The tree as text, as kvfWrite puts it into a file. The same tree gives the same bytes. Not a
/// number loses sign and payload; all else survives the text to the bit.
std::string kvfText(const KvfTree* tree);
/// Frees the tree and clears the handle.
void kvfClose(KvfHandle* handle);

// Reading.

/// What a file is loaded for: 1 a parameter file for editing or a run, 0 a result file. Both are
/// read alike.
/// A failure gives a null handle and sets the process's error.
KvfHandle kvfLoadFile(const std::string& path, int flag);
/// As kvfLoadFile from a text; `name` stands for the file in messages.
KvfHandle kvfLoadText(std::string_view text, const std::string& name);
/// Non-zero when the last load failed; leaves the error standing.
int kvfPeekErrorGlb();
/// Returns the error and clears it. Its place and text stay for kvfGetSyntaxErr until the next
/// load.
int kvfGetErrorGlb();
/// Place (line and column, counted from 1; 0 where the file could not be read at all) and
/// description of the last failed load, which names file, line, column and what was expected.
/// Null outputs are passed over. `tree` is the handle that the load gave and is not looked at.
void kvfGetSyntaxErr(const KvfTree* tree, int* line, int* column, std::string* text);

const KvfSection* kvfTargetByNameNum(const KvfTree* tree, std::string_view name, int occurrence);
const KvfSection* kvfSectionByNameNum(const KvfSection* parent, std::string_view name,
                                      int occurrence);
const KvfKeyword* kvfKeywordByNameNum(const KvfSection* parent, std::string_view name,
                                      int occurrence);
int kvfGetNoParams(const KvfKeyword* keyword);
const KvfParam* kvfParamByNum(const KvfKeyword* keyword, int index);
/// Non-zero when the parameter is a bool.
int kvfIsBool(const KvfParam* param);
bool kvfGetBool(const KvfParam* param);

/// Non-zero on success; zero, with `value` unchanged, when that occurrence or parameter does not
/// exist or holds a type that does not widen to the one asked for without loss (int to float where
/// exact, int and float to double; a file name counts as text).
int kvfGetParam(const KvfSection* parent, std::string_view keyword, int* value, int occurrence,
                int index);
int kvfGetParam(const KvfSection* parent, std::string_view keyword, bool* value, int occurrence,
                int index);
int kvfGetParam(const KvfSection* parent, std::string_view keyword, float* value, int occurrence,
                int index);
int kvfGetParam(const KvfSection* parent, std::string_view keyword, double* value, int occurrence,
                int index);
int kvfGetParam(const KvfSection* parent, std::string_view keyword, std::string* value,
                int occurrence, int index);
/// As kvfGetParam for text, for a parameter written by kvfPutParamFilename; takes a plain text too.
int kvfGetParamFilename(const KvfSection* parent, std::string_view keyword, std::string* value,
                        int occurrence, int index);
/// One pointer for each letter of `format` (only 'i'). Zero, with all values unchanged, when the
/// keyword does not exist, has fewer parameters, or one is no int.
int kvfGetListParam(const KvfSection* parent, std::string_view keyword, int occurrence,
                    std::string_view format, std::initializer_list<int*> values);
/// Appends a copy of all that one target or section holds to another, of the same tree or of
/// another one. The cursor stays where it is.
void kvfCopy(const KvfSection* source, KvfSection* destination);

// Walking a whole tree, for programs that show any file.

enum class KvfType { Int, Float, Double, Bool, Text, FileName };

/// Called for each part of a tree in file order.
class KvfVisitor {
  public:
    virtual ~KvfVisitor() = default;
    virtual void BeginSection(std::string_view name) = 0; ///< a target or a section
    virtual void EndSection() = 0;
    virtual void BeginKeyword(std::string_view name, int parameterCount) = 0;
    virtual void Parameter(const KvfParam& parameter) = 0;
    virtual void EndKeyword() = 0;
};
void kvfVisit(const KvfTree* tree, KvfVisitor& visitor);

KvfType kvfParamType(const KvfParam& parameter);
int kvfParamInt(const KvfParam& parameter);               ///< of an Int; else 0
double kvfParamDouble(const KvfParam& parameter);         ///< of any number; else 0
float kvfParamFloat(const KvfParam& parameter);           ///< of a Float; else 0
std::string_view kvfParamText(const KvfParam& parameter); ///< of a Text or FileName; else empty

} // namespace ryn
