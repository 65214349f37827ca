// A chained hash table of names whose walk order is exactly defined.
//
// All names are in one singly linked list, ordered by bucket. A name whose bucket is empty is
// linked at its position in that order; a name whose bucket is not empty follows the first name of
// the bucket. Growth processes the list from its head and puts each name at the front of its new
// bucket.
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace Orn_Hdl {

class NameTable {
public:
    struct Node {
        Node* next;
        std::uint32_t hash;
        std::string name;
    };

    explicit NameTable(bool ignoringCase) noexcept : ignoringCase_(ignoringCase) {}
    NameTable(const NameTable& other);
    NameTable& operator=(const NameTable&) = delete;
    ~NameTable();

    /// Does nothing if the name is present already.
    void Insert(std::string_view name);
    bool Contains(std::string_view name) const noexcept { return Find(name) != nullptr; }
    void Remove(std::string_view name) noexcept;
    /// Removes all names; the number of buckets does not change.
    void Empty() noexcept;
    bool IsEmpty() const noexcept { return count_ == 0; }
    const Node* GetFirst() const noexcept { return head_; }

private:
    std::uint32_t Hash(std::string_view name) const noexcept;
    bool Equal(const Node& node, std::uint32_t hash, std::string_view name) const noexcept;
    const Node* Find(std::string_view name) const noexcept;
    std::size_t BucketOf(std::uint32_t hash) const noexcept { return hash % buckets_.size(); }
    /// The link to the first name of a bucket, or where it would be inserted.
    Node** LinkInto(std::size_t bucket) noexcept;
    void Link(Node* node) noexcept;
    void Grow(std::size_t least);

    bool ignoringCase_;
    std::size_t count_ = 0;
    Node* head_ = nullptr;
    /// The first name of each bucket; empty until the first insertion.
    std::vector<Node*> buckets_;
};

} // namespace Orn_Hdl
