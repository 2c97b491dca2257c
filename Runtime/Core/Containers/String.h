#pragma once

#include <string>

namespace core
{

template <class Char>
using basic_string = std::basic_string<Char>;

using string = basic_string<char>;

} // namespace core
