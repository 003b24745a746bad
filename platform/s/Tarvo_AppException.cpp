#include "Tarvo_AppException.h"

namespace Tarvo {

// Defined here, so that one library holds what catchers in all others compare types by.
AppException::AppException(Level exceptionLevel, const Port::StringBase<char>& text)
    : std::runtime_error(text), level(exceptionLevel) {}

AppException::AppException(const AppException&) noexcept = default;

AppException& AppException::operator=(const AppException&) noexcept = default;

AppException::~AppException() = default;

const char* AppException::what() const noexcept { return std::runtime_error::what(); }

}  // namespace Tarvo
