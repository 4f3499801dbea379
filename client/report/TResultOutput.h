#pragma once

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "client/files/TCompressor.h"
#include "client/files/TSpooledText.h"
#include "client/files/TUnfinishedFile.h"
#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// Whether a result for that path goes to standard output: the path is empty or "-".
bool IsStandardOutput(const std::string& path);

/// Whether one of two results would replace the other, because both paths lead to one ordinary file, whether or not it is there.
/// A path of standard output stands for the file to which that goes. Devices, pipes and two open descriptors take any number of
/// results. Errors: TClientError if links lead nowhere.
bool AreSameTarget(const std::string& a, const std::string& b);

/// Checks, without changing anything, whether a result can be delivered to that path and would not replace one of the `inputs`,
/// which are paths too, with "-" for standard input. A device may still turn out to be full.
/// Errors: TClientError, also if the name asks for a compression that cannot be written.
void CheckOutput(const std::string& path, const std::vector<std::string>& inputs);

/// The same for rules and accepted differences, which are read as plain text only. Errors: also TClientError if the name asks for
/// compression.
void CheckPlainOutput(const std::string& path, const std::vector<std::string>& inputs);

/// A result on its way to the file of a path, or to the console's standard output if IsStandardOutput(path). If the name asks for
/// it (CompressionOfName), it is compressed. Memory, however long it is: that of a TSpooledText, and of a TCompressor if it is
/// compressed.
///
/// Nothing of it is to be seen before Deliver. A file appears whole or not at all: what was there stays until the new text is on
/// the disk. Links are followed and stay. A device, a pipe or an open descriptor (/dev/stdout) is written to, not replaced.
/// Errors of all operations: TReaderGone if the reader has closed the pipe, TClientError, std::bad_alloc. Only destroy it then.
class TResultOutput {
  public:
    /// `console` must outlive this.
    TResultOutput(IConsole& console, std::string path);
    TResultOutput(const TResultOutput&) = delete;
    TResultOutput& operator=(const TResultOutput&) = delete;
    ~TResultOutput() = default;

    /// Takes the next piece of the result.
    void Write(std::string_view piece);

    /// Delivers the result; `end` is its last piece. Call this once.
    void Deliver(std::string_view end = std::string_view());

  private:
    void Keep(std::string_view piece);
    void WriteToFile();
    void ForEachPiece(std::string_view end, const TSpooledText::TCallback& callback) const;
    void WriteTo(int descriptor, std::string_view end) const;
    void WriteSpecial(std::string_view end) const;
    void ReplaceFile(std::string_view end);

    IConsole& fConsole;
    const std::string fPath;
    std::string fTarget;                     // the path at the end of all links
    std::optional<int> fDescriptor;          // the open descriptor that the path stands for
    std::unique_ptr<TUnfinishedFile> fFile;  // if an ordinary file is to be replaced
    std::string fPiece;                      // what the file gets next
    TSpooledText fText;                      // the result if there is no fFile
    std::unique_ptr<TCompressor> fCompressor;
};

/// Delivers a result that is at hand as a whole. Errors: those of TResultOutput.
void DeliverResult(IConsole& console, const std::string& path, std::string_view text);

}  // namespace NORVZEL20
