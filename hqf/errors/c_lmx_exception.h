#pragma once

#include "hqf/errors/elmx_error.h"

/// Two exception classes for applications that prefer to throw a code. The library itself never throws them.

namespace lmx {

/// Carries an error code. It has no base class: catch it by its own name.
class HQF_API c_lmx_exception {
public:
    explicit c_lmx_exception(elmx_error code)
        : error_(code) {}
    c_lmx_exception(const c_lmx_exception&) = default;
    c_lmx_exception& operator=(const c_lmx_exception&) = default;
    virtual ~c_lmx_exception();

    /// The sentence of the code, as `get_error_description` gives it; never null.
    virtual const char* what() const;

    elmx_error get_error() const { return error_; }

private:
    elmx_error error_;
};

/// A code with the line of the document that it is about.
class HQF_API c_lmx_reader_exception : public c_lmx_exception {
public:
    /// \param line line in the document, counted from 1
    c_lmx_reader_exception(elmx_error code, int line)
        : c_lmx_exception(code)
        , line_(line) {}
    c_lmx_reader_exception(const c_lmx_reader_exception&) = default;
    c_lmx_reader_exception& operator=(const c_lmx_reader_exception&) = default;
    ~c_lmx_reader_exception() override;

    int get_line() const { return line_; }

private:
    int line_;
};

} // namespace lmx
