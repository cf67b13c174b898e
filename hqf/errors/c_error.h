#pragma once

#include "hqf/errors/elmx_error.h"

/// The record of what the XML input layers report, and the scope object that tells it who is reading.

namespace lmx {

class c_get_as_utf8;
class c_getter_error_binder;

/// Keeps the first fatal report of a parse and counts the rest. Derive from it and override `report_error` to see every
/// report with its text.
///
/// One thread at a time. Doesn't own the getter, which must unbind (or end) before this object does.
class HQF_API c_error {
public:
    c_error() = default;
    c_error(const c_error&) = default;
    c_error& operator=(const c_error&) = default;

    /// Called once for each recorded report, after the record has changed. Does nothing by default.
    ///
    /// \param source name of the input, null when it has none
    /// \param line line in the input, counted from 1; -1 when nobody reads
    virtual void report_error(elmx_error_type type, elmx_error code, const char* source, int line, const char* text);
    virtual ~c_error();

    /// Records a report and passes it to `report_error`. After a fatal report every further one is ignored.
    void error(elmx_error_type type, elmx_error code, const char* source, int line, const char* text);
    /// The same, with source and line of the getter that is bound: a null source and line -1 when none is.
    void error(elmx_error_type type, elmx_error code, const char* text);

    /// Whether a fatal report or an error has been recorded; warnings don't count.
    bool is_errored() const { return fatal_count_ != 0 || error_count_ != 0; }
    /// Whether a fatal report has been recorded.
    bool is_fatal_errored() const { return fatal_count_ != 0; }

    /// Code of the last recorded report of any grade; 0 when there is none.
    elmx_error get_last_error() const { return last_error_; }
    /// Grade of the last recorded report; `error_none` when there is none.
    elmx_error_type get_last_error_type() const { return last_type_; }

    /// Gives the last recorded report. None of the pointers may be null.
    ///
    /// \returns false when the last code is 0; then nothing is stored
    bool get_error_info(elmx_error_type* type, elmx_error* code, int* line) const;

    /// Makes the binder's new getter the one that reads now, and gives the one that did before. For
    /// `c_getter_error_binder`.
    c_get_as_utf8* register_getter(const c_getter_error_binder& binder);
    /// Puts the binder's old getter back.
    void unregister_getter(const c_getter_error_binder& binder);

private:
    c_get_as_utf8* getter_ = nullptr;
    int fatal_count_ = 0;
    int error_count_ = 0; // fatal reports count here too
    int lesser_count_ = 0;
    int notice_count_ = 0;
    elmx_error_type last_type_ = error_none;
    elmx_error last_error_ = err_no_error;
    int last_line_ = -1;
};

/// Ties a getter to an error object for a scope: while it lives, reports without a line of their own get the getter's.
///
/// Binders of one error object must end in reverse order of their start.
class HQF_API c_getter_error_binder {
public:
    explicit c_getter_error_binder(c_error& errors)
        : errors_(errors) {}
    c_getter_error_binder(const c_getter_error_binder&) = delete;
    c_getter_error_binder& operator=(const c_getter_error_binder&) = delete;
    /// Puts the old getter back, if `bind` was called.
    ~c_getter_error_binder();

    /// Makes `getter` the one that reads now. Only the first call acts.
    void bind(c_get_as_utf8* getter);

    c_get_as_utf8* get_new_getter() const { return new_getter_; }
    c_get_as_utf8* get_old_getter() const { return old_getter_; }

private:
    bool is_bound_ = false;
    c_error& errors_;
    c_get_as_utf8* new_getter_ = nullptr;
    c_get_as_utf8* old_getter_ = nullptr;
};

} // namespace lmx
