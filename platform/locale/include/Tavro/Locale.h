/// \file
/// Texts in the language of the process's environment. All functions may be called from several
/// threads at once; none touches the C or C++ locale of the process.
#ifndef TAVRO_LOCALE_H
#define TAVRO_LOCALE_H

#include <memory>
#include <string>

namespace Tavro {

namespace Locale {

/// The language for messages, such as en_US or de: the first of LC_ALL, LC_MESSAGES and LANG that is
/// neither unset nor empty, without its encoding and modifier. Never empty: en_US stands for C, POSIX,
/// for an environment that names none, and for a name with anything but letters, digits, - and _ in it.
std::string getLanguageId();

/// What ResourceString needs to find the texts of resource library number `library` in `language`. Its
/// form is this library's own business.
std::wstring getResourceLibrary(int library, const std::string& language);

} // namespace Locale

/// A text of a resource library.
class ResourceString
{
public:
    /// \param library    an answer of Locale::getResourceLibrary
    /// \param messageId  such as MSGID_ALARMDEVICE_CAPTION. One that nobody has a text for is remembered until the
    ///     library is unloaded: ids are a program's constants.
    ResourceString(const std::wstring& library, const std::wstring& messageId);
    ~ResourceString();

    ResourceString(const ResourceString&) = delete;
    ResourceString& operator=(const ResourceString&) = delete;

    /// The text; in English where the language has none; the message id itself where English has none.
    operator std::wstring() const;

private:
    struct Implementation;
    std::unique_ptr<Implementation> implementation_;
};

/// `text` in UTF-8. What is no Unicode scalar value (a surrogate, a number above U+10FFFF) becomes the
/// replacement character U+FFFD.
std::string make_string(const std::wstring& text);

} // namespace Tavro

#endif
