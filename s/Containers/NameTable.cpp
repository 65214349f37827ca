#include "Containers/NameTable.h"

#include "Containers/Hash.h"
#include "Port/Ascii.h"

#include <algorithm>
#include <iterator>

namespace Orn_Hdl {

namespace {

constexpr std::size_t FirstRequest = 100;
/// The number of buckets that can be read in the time of one step along the list.
constexpr std::size_t BucketsAStep = 8;

constexpr std::uint32_t BucketCounts[] = {
    53,        97,        193,       389,       769,        1543,       3079,
    6151,      12289,     24593,     49157,     98317,      196613,     393241,
    786433,    1572869,   3145739,   6291469,   12582917,   25165843,   50331653,
    100663319, 201326611, 402653189, 805306457, 1610612741, 3221225473, 4294967291};

std::size_t BucketCountFor(std::size_t least) noexcept {
    const auto* const found =
        std::lower_bound(std::begin(BucketCounts), std::end(BucketCounts), least);
    return found == std::end(BucketCounts) ? *std::prev(found) : *found;
}

} // namespace

// Copies into a complete table, whose destructor destroys the copies if allocation fails.
NameTable::NameTable(const NameTable& other) : NameTable(other.ignoringCase_) {
    buckets_.resize(other.buckets_.size());
    Node** tail = &head_;
    for (const Node* node = other.head_; node != nullptr; node = node->next) {
        *tail = new Node{nullptr, node->hash, node->name};
        Node*& first = buckets_[BucketOf(node->hash)];
        if (first == nullptr) {
            first = *tail;
        }
        tail = &(*tail)->next;
        ++count_;
    }
}

NameTable::~NameTable() {
    Empty();
}

std::uint32_t NameTable::Hash(std::string_view name) const noexcept {
    return ignoringCase_ ? HashIgnoringCase(name) : HashExact(name);
}

bool NameTable::Equal(const Node& node, std::uint32_t hash, std::string_view name) const noexcept {
    return node.hash == hash &&
           (ignoringCase_ ? Port::EqualIgnoringCase(node.name, name) : node.name == name);
}

const NameTable::Node* NameTable::Find(std::string_view name) const noexcept {
    if (count_ == 0) {
        return nullptr;
    }
    const std::uint32_t hash = Hash(name);
    const std::size_t bucket = BucketOf(hash);
    for (const Node* node = buckets_[bucket]; node != nullptr && BucketOf(node->hash) == bucket;
         node = node->next) {
        if (Equal(*node, hash, name)) {
            return node;
        }
    }
    return nullptr;
}

void NameTable::Insert(std::string_view name) {
    if (Contains(name)) {
        return;
    }
    auto node = std::make_unique<Node>(Node{nullptr, Hash(name), std::string(name)});
    if (buckets_.empty()) {
        buckets_.resize(BucketCountFor(FirstRequest));
    } else if (count_ + 1 > buckets_.size()) {
        Grow(count_ + 1);
    }
    Link(node.release());
    ++count_;
}

NameTable::Node** NameTable::LinkInto(std::size_t bucket) noexcept {
    // The previous non-empty bucket is usually near. In a table that once held many more names, a
    // walk along the list is shorter.
    const std::size_t least = bucket - std::min(bucket, BucketsAStep * count_);
    std::size_t lower = bucket;
    while (lower > least && buckets_[lower - 1] == nullptr) {
        --lower;
    }
    if (lower == least) {
        Node** link = &head_;
        while (*link != nullptr && BucketOf((*link)->hash) < bucket) {
            link = &(*link)->next;
        }
        return link;
    }
    Node* last = buckets_[--lower];
    while (last->next != nullptr && BucketOf(last->next->hash) == lower) {
        last = last->next;
    }
    return &last->next;
}

void NameTable::Link(Node* node) noexcept {
    Node*& first = buckets_[BucketOf(node->hash)];
    if (first != nullptr) {
        node->next = first->next;
        first->next = node;
        return;
    }
    Node** link = LinkInto(BucketOf(node->hash));
    node->next = *link;
    *link = node;
    first = node;
}

void NameTable::Grow(std::size_t least) {
    // The chain of each bucket is built separately; then the chains are joined in bucket order.
    buckets_.assign(BucketCountFor(least), nullptr);
    for (Node* node = head_; node != nullptr;) {
        Node* const next = node->next;
        Node*& first = buckets_[BucketOf(node->hash)];
        node->next = first;
        first = node;
        node = next;
    }
    Node** tail = &head_;
    for (Node* node : buckets_) {
        for (*tail = node; *tail != nullptr;) {
            tail = &(*tail)->next;
        }
    }
}

void NameTable::Remove(std::string_view name) noexcept {
    const Node* const found = Find(name);
    if (found == nullptr) {
        return;
    }
    const std::size_t bucket = BucketOf(found->hash);
    Node** link = LinkInto(bucket);
    while (*link != found) {
        link = &(*link)->next;
    }
    Node* const node = *link;
    *link = node->next;
    if (buckets_[bucket] == node) {
        const bool more = node->next != nullptr && BucketOf(node->next->hash) == bucket;
        buckets_[bucket] = more ? node->next : nullptr;
    }
    delete node;
    --count_;
}

void NameTable::Empty() noexcept {
    while (head_ != nullptr) {
        Node* const next = head_->next;
        delete head_;
        head_ = next;
    }
    std::fill(buckets_.begin(), buckets_.end(), nullptr);
    count_ = 0;
}

} // namespace Orn_Hdl
