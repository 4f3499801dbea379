// Loads a document into a namespace that already holds the sample, once whole and once in small pieces.
//
// Both loads must have the same outcome. A refused document must leave the namespace as it was. An accepted one is written, loaded
// alone into an empty namespace and written again: both texts must be equal, so nothing is lost on the way.

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

/// The sample as a document, before anything is loaded over it.
const std::string& SampleText()
{
    static const std::string fgText = WriteDocument(*LoadSample());
    return fgText;
}

/// Runs `load` and returns the namespace as a document, or the error. `before` is the namespace as it was.
template <class TLoad>
std::string Outcome(TInMemNamespace& ns, const std::string& before, TLoad load)
{
    try {
        load();
    } catch (const TPopulateError& error) {
        Promise(std::string(error.what()).compare(0, 8, "fuzz.xml") == 0, "an error begins with the document's name", error.what());
        Promise(!error.GetMessage().empty(), "an error has a text");
        PromiseEqual(before, WriteDocument(ns), "a failed load leaves the namespace as it was");
        // The position of malformed XML depends on the pieces that the parser got, so only the message is compared.
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

void FuzzInventory(std::string_view input)
{
    const std::string loaded = LoadWhole(LoadSample(), SampleText(), input);
    PromiseEqual(loaded, LoadPieces(LoadSample(), SampleText(), input), "a document loads the same whole and in pieces");
    if (loaded.compare(0, 9, "refused: ") != 0) {
        PromiseEqual(loaded, LoadAlone(loaded), "a written document loads as it was");
    }
}

}  // namespace NORVZEL20
