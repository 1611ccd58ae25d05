#include "varnex3/core/Error.h"

#include <cerrno>
#include <new>
#include <stdexcept>
#include <string>
#include <system_error>
#include <utility>

namespace varnex3 {

Error::Error(ErrorNumber number_, Text source_, Text description_)
    : number(number_),
      source(std::move(source_)),
      description(std::move(description_)),
      message(ToUtf8(source + u": " + description) + " (" + std::to_string(Number()) + ")")
{}

Error Error::About(Name operation, TextView subject) const
{
    if (!source.empty())
        return *this;
    return {number, ToText(operation), subject.empty() ? description : Text(subject) + u": " + description};
}

void Raise(ErrorNumber number, Name operation, Text description)
{
    throw Error(number, ToText(operation), std::move(description));
}

Text Quoted(TextView value)
{
    constexpr std::size_t kShown = 60;
    return value.size() <= kShown ? u"'" + Text(value) + u"'" : u"'" + Text(value.substr(0, kShown)) + u"...'";
}

Error FileError(int systemError, Name operation, TextView path)
{
    const auto error = [&](ErrorNumber number, TextView words) {
        return Error(number, ToText(operation), Quoted(path) + u": " + Text(words));
    };
    switch (systemError) {
    case ENOENT:
    case ENOTDIR:
        return error(ErrorNumber::FileNotFound, u"file not found");
    case EACCES:
    case EPERM:
        return error(ErrorNumber::PermissionDenied, u"permission denied");
    case EISDIR:
        return error(ErrorNumber::PathFileAccess, u"is a folder");
    default:
        return error(ErrorNumber::DeviceInputOutput, ToUtf16(std::generic_category().message(systemError)));
    }
}

Error CurrentError(Name operation)
{
    try {
        throw;
    } catch (const Error& error) {
        return error.About(operation, {});
    } catch (const std::bad_alloc&) {
        return {ErrorNumber::OutOfMemory, ToText(operation), u"out of memory"};
    } catch (const std::length_error&) {
        return {ErrorNumber::OutOfMemory, ToText(operation), u"out of memory: the text is too long"};
    } catch (const std::system_error& error) {
        return FileError(error.code().value(), operation, {});
    } catch (const std::exception& error) {
        return {ErrorNumber::Internal, ToText(operation), u"internal error: " + ToUtf16(error.what())};
    } catch (...) {
        return {ErrorNumber::Internal, ToText(operation), u"internal error"};
    }
}

} // namespace varnex3
