#pragma once

namespace lmx {

/// The value of a type without content.
class c_empty {};

} // namespace lmx
