// One load, from bytes to a namespace:
//
//     file, memory or source --bytes--> TXmlReader --events--> TCimXmlReader --classes, instances--> TCimXmlLoader --> namespace
//
// TLoad owns these parts and the TCimXmlContext that they share (the place for messages, the report, the pool of texts). All of
// them live for one load only. If anything throws, TLoad is destroyed, and the loader takes back what it added, so a load is all
// or nothing.
#include "embedded/cimxml/TCimXmlPopulator.h"

#include <algorithm>
#include <boost/ref.hpp>
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <memory>
#include <utility>

#include "embedded/cimxml/TCimXmlContext.h"
#include "embedded/cimxml/TCimXmlLoader.h"
#include "embedded/cimxml/TCimXmlReader.h"
#include "embedded/cimxml/TXmlReader.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

namespace {

using EStatus = TZELStatusCode::EStatusCode;

constexpr std::size_t kReadPiece = 256 * 1024;

struct TFileCloser {
    void operator()(std::FILE* file) const noexcept { std::fclose(file); }
};

/// Reads a file piece by piece.
class TFileSource {
  public:
    explicit TFileSource(const std::string& path) : fPath(path), fFile(std::fopen(path.c_str(), "rb"))
    {
        if (!fFile) {
            Fail("cannot open the file: ");
        }
    }

    std::size_t operator()(char* buffer, std::size_t size)
    {
        const std::size_t length = std::fread(buffer, 1, size, fFile.get());
        if (std::ferror(fFile.get()) != 0) {
            Fail("cannot read the file: ");
        }
        return length;
    }

  private:
    [[noreturn]] void Fail(const char* what) const
    {
        throw TPopulateError(EStatus::kFileError, std::string(what) + std::strerror(errno), fPath, 0, 0);
    }

    std::string fPath;
    std::unique_ptr<std::FILE, TFileCloser> fFile;
};

/// One load, from its first byte to its end.
class TLoad {
  public:
    TLoad(const boost::shared_ptr<TInMemNamespace>& ns, const std::string& name, TXmlReader::EParser parser)
        : fContext(name), fLoader(fContext, ns), fReader(fContext, ns, &fLoader), fXml(fReader, parser)
    {
        fContext.SetReader(fXml);
    }

    void ReadMemory(const char* data, std::size_t length)
    {
        RefuseEmpty(length);
        Check(fXml.Parse(data, length, true));
    }

    void ReadSource(const TCimXmlPopulator::TPullSource& source)
    {
        std::size_t total = 0;
        std::size_t length = 0;
        std::size_t room = 0;
        do {
            // A tag that has not ended is read again with each piece. Pieces as long as that tag keep the total linear.
            room = std::max(kReadPiece, fXml.GetPending());
            length = Fill(source, fXml.GetBuffer(room), room);
            total += length;
            Check(fXml.ParseBuffer(length));
        } while (length == room);
        RefuseEmpty(total);
        Check(fXml.Finish());
    }

    TCimXmlLoader& GetLoader() noexcept { return fLoader; }

    void Finish()
    {
        fContext.Guard([this] { fLoader.Finish([this](const TCIMValue& value) { return fReader.GetObjects().ReadAll(value); }); });
    }

    /// Keeps what was loaded; nothing can fail any more.
    TLoadReport Commit() noexcept
    {
        fLoader.Commit();
        return std::move(fContext.GetReport());
    }

  private:
    /// Pulls until the room is full or the document ends: many small pieces would be parsed slowly.
    static std::size_t Fill(const TCimXmlPopulator::TPullSource& source, char* buffer, std::size_t room)
    {
        std::size_t length = 0;
        while (length < room) {
            const std::size_t more = source(buffer + length, room - length);
            if (more == 0) {
                break;
            }
            length += more;
        }
        return length;
    }

    void RefuseEmpty(std::size_t length) const
    {
        if (length == 0) {
            fContext.Fail(EStatus::kParseError, "found an empty document, expected CIM-XML");
        }
    }

    void Check(bool succeeded) const
    {
        if (!succeeded) {
            fContext.Fail(EStatus::kParseError, "found malformed XML: " + fXml.GetError());
        }
    }

    TCimXmlContext fContext;
    TCimXmlLoader fLoader;
    TCimXmlReader fReader;
    TXmlReader fXml;
};

}  // namespace

TCimXmlPopulator::TCimXmlPopulator(boost::shared_ptr<ICIMNamespace> ns) : fNamespace(std::move(ns)) {}

template <class TRead>
TLoadReport TCimXmlPopulator::Load(const std::string& name, TRead read)
{
    const auto ns = boost::dynamic_pointer_cast<TInMemNamespace>(fNamespace);
    if (!ns) {
        throw TPopulateError(EStatus::kNotSupported, "the namespace is not one of the provider \"inmem\"; load into one of those",
                             name, 0, 0);
    }
    TLoad load(ns, name, fUsesExpatAlone ? TXmlReader::EParser::kExpat : TXmlReader::EParser::kTokenizer);
    if (fKeep) {
        load.GetLoader().KeepElements();
    }
    read(load);
    load.Finish();
    fElements = load.GetLoader().TakeElements();
    return load.Commit();
}

TLoadReport TCimXmlPopulator::LoadFromMemory(const char* data, std::size_t length, const std::string& name)
{
    return Load(name, [&](TLoad& load) { load.ReadMemory(data, length); });
}

TLoadReport TCimXmlPopulator::LoadFromSource(const TPullSource& source, const std::string& name)
{
    return Load(name, [&](TLoad& load) { load.ReadSource(source); });
}

/// The source is passed by reference, because it owns the open file.
TLoadReport TCimXmlPopulator::LoadFile(const std::string& path)
{
    TFileSource file(path);
    return LoadFromSource(boost::ref(file), path);
}

std::vector<boost::shared_ptr<ICIMElement>> TCimXmlPopulator::TakeElements()
{
    return std::exchange(fElements, {});
}

}  // namespace NORVZEL20
