#include <algorithm>
#include <cstring>

#include "embedded/cimxml/TCimXmlPopulator.h"
#include "fuzz/Promise.h"
#include "fuzz/SampleInventory.h"
#include "fuzz/TFuzzTarget.h"

namespace NORVZEL20 {

namespace {

/// Delivers a text in small pieces.
class TSlowSource {
  public:
    TSlowSource(std::string_view text, std::size_t piece) : fText(text), fPiece(piece) {}

    std::size_t operator()(char* buffer, std::size_t size)
    {
        const std::size_t count = std::min({fPiece, size, fText.size()});
        std::memcpy(buffer, fText.data(), count);
        fText.remove_prefix(count);
        return count;
    }

  private:
    std::string_view fText;
    std::size_t fPiece;
};

/// The sample before anything is loaded over it.
const std::string& SampleText()
{
    static const std::string fgText = WriteDocument(*LoadSample());
    return fgText;
}

/// The namespace, which held what `before` says, after a load into it, or the error.
template <class TLoad>
std::string Outcome(TInMemNamespace& ns, const std::string& before, TLoad load)
{
    try {
        load();
    } catch (const TPopulateError& error) {
        Promise(std::string(error.what()).compare(0, 8, "fuzz.xml") == 0, "an error begins with the document's name", error.what());
        Promise(!error.GetMessage().empty(), "an error has a text");
        PromiseEqual(before, WriteDocument(ns), "a failed load leaves the namespace as it was");
        // How far the parser has come in text that is no XML depends on the pieces it got.
        return "refused: " + (error.GetMessage().rfind("found malformed XML", 0) == 0 ? error.GetMessage() : error.what());
    }
    return WriteDocument(ns);
}

std::string LoadWhole(const boost::shared_ptr<TInMemNamespace>& ns, const std::string& before, std::string_view text)
{
    return Outcome(*ns, before, [&] { TCimXmlPopulator(ns).LoadFromMemory(text.data(), text.size(), "fuzz.xml"); });
}

std::string LoadPieces(const boost::shared_ptr<TInMemNamespace>& ns, const std::string& before, std::string_view text)
{
    return Outcome(*ns, before, [&] { TCimXmlPopulator(ns).LoadFromSource(TSlowSource(text, 1 + text.size() % 7), "fuzz.xml"); });
}

std::string LoadAlone(std::string_view text)
{
    const boost::shared_ptr<TInMemNamespace> ns = TInMemNamespace::Create("root/cimv2");
    return LoadWhole(ns, WriteDocument(*ns), text);
}

}  // namespace

/// A document is loaded over the sample, whole and in pieces; what loads is written, loaded alone and written again.
void FuzzInventory(std::string_view input)
{
    const std::string loaded = LoadWhole(LoadSample(), SampleText(), input);
    PromiseEqual(loaded, LoadPieces(LoadSample(), SampleText(), input), "a document means the same whole and in pieces");
    if (loaded.compare(0, 9, "refused: ") != 0)
        PromiseEqual(loaded, LoadAlone(loaded), "what is written loads as it was");
}

}  // namespace NORVZEL20
