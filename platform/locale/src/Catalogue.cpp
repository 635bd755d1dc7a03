#include "Catalogue.h"

#include "CatalogueDirectory.h"
#include "EnglishCatalogue.h"
#include "MessageCatalogue.h"

#include "Tavro/Locale.h"

#include <HeldOverFork.h>
#include <ReadFile.h>

#include <MVLog/MVLogger.h>

#include <algorithm>
#include <cstddef>
#include <cstdlib>
#include <map>
#include <memory>
#include <mutex>
#include <optional>
#include <set>
#include <string_view>

namespace Tavro {
namespace {

constexpr wchar_t separator = L'/';
constexpr char endOfContext = '\4';
constexpr std::size_t mostBytes = 1024UL * 1024; ///< of a catalogue; thousands of messages
constexpr std::size_t longestLanguage = 64;
constexpr int errorLevel = 6000;

bool isPartOfLanguage(wchar_t character)
{
    return (character >= L'a' && character <= L'z') || (character >= L'A' && character <= L'Z') ||
           (character >= L'0' && character <= L'9') || character == L'-' || character == L'_';
}

/// The name as catalogues have it; empty for what names no language. Without this check it could name
/// any file.
std::string fileLanguage(std::wstring_view name)
{
    if (name.size() > longestLanguage || !std::all_of(name.begin(), name.end(), isPartOfLanguage))
        return {};
    std::string language;
    for (const wchar_t character : name)
        language += character == L'-' ? '_' : static_cast<char>(character);
    return language;
}

/// zh_Hans of zh_Hans_CN; empty of zh.
std::string withoutLastPart(const std::string& language)
{
    const std::string::size_type end = language.rfind('_');
    return end == std::string::npos ? std::string() : language.substr(0, end);
}

/// Null: it is not there.
const std::wstring* findIn(const Messages& messages, const std::string& key)
{
    const auto found = messages.find(key);
    return found == messages.end() ? nullptr : &found->second;
}

/// The catalogues read so far, and what was asked for last: a request asks for the same text over and over.
class Catalogues
{
public:
    const std::wstring& text(const std::wstring& catalogue, const std::wstring& messageId)
    {
        const char* const folder = directory();
        if (!last_ || last_->directory != folder || last_->catalogue != catalogue ||
            last_->messageId != messageId)
            last_ = Answer{folder, catalogue, messageId, &textOrId(folder, catalogue, messageId)};
        return *last_->text;
    }

private:
    struct Answer
    {
        std::string directory;
        std::wstring catalogue;
        std::wstring messageId;
        const std::wstring* text; ///< of a catalogue or of the ids without text
    };

    /// The folder that TAVRO_CATALOGUES names now, or the one beside this library.
    [[nodiscard]] const char* directory() const
    {
        const char* const named = secure_getenv("TAVRO_CATALOGUES");
        return named != nullptr && *named != '\0' ? named : installed_.c_str();
    }

    const std::wstring& textOrId(const std::string& folder, const std::wstring& catalogue,
                                 const std::wstring& messageId)
    {
        const std::wstring* const text = find(folder, catalogue, messageId);
        return text != nullptr ? *text : *idsWithoutText_.insert(messageId).first;
    }

    /// Null: there is none.
    const std::wstring* find(const std::string& folder, const std::wstring& catalogue,
                             const std::wstring& messageId)
    {
        const std::wstring::size_type end = catalogue.find(separator);
        if (end == std::wstring::npos)
            return nullptr;
        const std::string key = make_string(catalogue.substr(0, end)) + endOfContext + make_string(messageId);
        for (std::string language = fileLanguage(catalogue.substr(end + 1)); !language.empty();
             language = withoutLastPart(language))
            if (const std::wstring* const text = findIn(messagesIn(folder, language), key))
                return text;
        return findIn(english_, key);
    }

    /// Reads the catalogue the first time it is asked for. Empty: there is none.
    const Messages& messagesIn(const std::string& folder, const std::string& language)
    {
        const std::string file = folder + '/' + language + "/LC_MESSAGES/tavro.mo";
        const auto found = byFile_.find(file);
        return found != byFile_.end() ? found->second : byFile_.emplace(file, read(file)).first->second;
    }

    static Messages read(const std::string& file)
    {
        try {
            return readMessages(readFile(file, mostBytes));
        } catch (const FileMissing&) {
            return {};
        } catch (const ReadFailure& failure) {
            return broken(file, failure.what());
        } catch (const CatalogueError& error) {
            return broken(file, error.what());
        }
    }

    static Messages broken(const std::string& file, const std::string& reason)
    {
        MVLog::MVLogger::logLevelMessage("read", "Catalogue.cpp", __LINE__, "Mavrel.Locale", errorLevel,
                                         nullptr, 0, 0, file + ": " + reason);
        return {};
    }

    std::string installed_ = installedCatalogues();
    Messages english_ = readMessages(englishCatalogue);
    std::map<std::string, Messages> byFile_;
    std::set<std::wstring> idsWithoutText_;
    std::optional<Answer> last_;
};

// Set up at compile time and without destructors: any static object may ask for a text.
std::mutex access; ///< guards `catalogues`
Catalogues* catalogues = nullptr;

/// Runs before anything that uses the library is set up, and after that of the log, which is asked for with the
/// lock held: fork() takes the two locks in the same order.
[[gnu::constructor]] void letChildrenRead()
{
    holdOverFork<access>();
}

/// Runs when the library is unloaded or, at the end of the process, after the static objects of all
/// that use it are gone.
[[gnu::destructor]] void close()
{
    const std::lock_guard<std::mutex> guard(access);
    delete catalogues;
    catalogues = nullptr;
}

} // namespace

std::wstring catalogueName(int library, const std::string& language)
{
    // Names of languages are ASCII; of anything else no catalogue exists, whatever it widens to.
    // Widened here, since std::to_wstring() takes a lock of the C library, which a forked child may never get.
    const std::string number = std::to_string(library);
    std::wstring name(number.size() + 1 + language.size(), separator);
    std::copy(number.begin(), number.end(), name.begin());
    std::copy(language.rbegin(), language.rend(), name.rbegin());
    return name;
}

const std::wstring& findText(const std::wstring& catalogue, const std::wstring& messageId)
{
    const std::lock_guard<std::mutex> guard(access);
    if (catalogues == nullptr)
        catalogues = std::make_unique<Catalogues>().release();
    return catalogues->text(catalogue, messageId);
}

} // namespace Tavro
