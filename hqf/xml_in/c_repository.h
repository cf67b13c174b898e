#pragma once

#include <cstddef>
#include <cstring>
#include <map>
#include <memory>
#include <string_view>
#include <utility>
#include <vector>

namespace lmx {

/// How a repository keeps its values: numbers as they are.
template<class T>
struct c_rep_ops {
    static T copy(T value) { return value; }
    static void release(T) {}
};

/// Texts are copied and belong to the repository.
template<>
struct c_rep_ops<const char*> {
    static const char* copy(const char* value) {
        const std::size_t size = std::strlen(value) + 1;
        return static_cast<const char*>(std::memcpy(new char[size], value, size));
    }
    static void release(const char* value) { delete[] value; }
};

/// An ordered list of pairs of a text key and a value, searched from the front. It owns a copy of each key.
///
/// Used for entities (values are texts, owned too) and for namespaces (values are numbers). An empty one allocates
/// nothing. A long one keeps an index beside the list, so that a document with very many names doesn't make every
/// search walk over all of them; results and order are those of the list.
template<class T, class Ops = c_rep_ops<T>>
class c_repository {
public:
    c_repository() = default;
    c_repository(const c_repository&) = delete;
    c_repository& operator=(const c_repository&) = delete;

    /// Frees all copies and empties the list.
    virtual void clear() {
        index_.reset();
        for (const entry& e : entries_) {
            c_rep_ops<const char*>::release(e.key);
            Ops::release(e.value);
        }
        entries_.clear();
    }
    virtual ~c_repository() { c_repository::clear(); }

    /// Appends the pair, or replaces the value of a key that is there: the last definition wins, at the old place.
    void add(const char* key, T value) {
        if (entry* const old = find_entry(key)) {
            const T replaced = old->value;
            old->value = Ops::copy(value);
            Ops::release(replaced);
            return;
        }
        if (entries_.size() == entries_.capacity()) entries_.reserve(2 * entries_.size() + 2);
        std::unique_ptr<const char[]> kept_key(c_rep_ops<const char*>::copy(key));
        entries_.push_back({kept_key.get(), Ops::copy(value)});
        add_to_index(entries_.size() - 1, kept_key.release());
    }

    /// Gives the key's value. False, and `*value` as it was, when there is none.
    bool find(const char* key, T* value) const {
        const entry* const found = find_entry(key);
        if (found == nullptr) return false;
        *value = found->value;
        return true;
    }
    bool has_key(const char* key) const { return find_entry(key) != nullptr; }
    /// The first key that has this value, or null. For numbers.
    const char* find_key(T value) const {
        for (const entry& e : entries_)
            if (e.value == value) return e.key;
        return nullptr;
    }
    bool empty() const { return entries_.empty(); }

private:
    static constexpr std::size_t longest_without_index = 16;
    struct entry {
        const char* key;
        T value;
    };
    using key_index = std::map<std::string_view, std::size_t>;

    const entry* find_entry(const char* key) const {
        if (index_ != nullptr) {
            const auto found = index_->find(key);
            return found == index_->end() ? nullptr : &entries_[found->second];
        }
        for (const entry& e : entries_)
            if (std::strcmp(e.key, key) == 0) return &e;
        return nullptr;
    }
    entry* find_entry(const char* key) { return const_cast<entry*>(std::as_const(*this).find_entry(key)); }

    void add_to_index(std::size_t place, const char* key) {
        if (index_ != nullptr) {
            index_->emplace(key, place);
        } else if (entries_.size() > longest_without_index) {
            auto index = std::make_unique<key_index>();
            for (std::size_t i = 0; i < entries_.size(); ++i)
                index->emplace(entries_[i].key, i);
            index_ = std::move(index);
        }
    }

    std::vector<entry> entries_;
    std::unique_ptr<key_index> index_;
};

} // namespace lmx
