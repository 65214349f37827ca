// A chained hash table of names whose walk order is exactly defined.
//
// All names stand on one singly linked list, ordered by bucket. A name whose bucket is empty is
// linked in where that order wants it; a name whose bucket is not empty goes directly behind the
// bucket's first name. Growing takes the list apart from its head and puts each name at the front
// of its new bucket.
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

    /// \return false when the name is there already.
    bool Insert(std::string_view name);
    bool Contains(std::string_view name) const noexcept { return Find(name) != nullptr; }
    void Remove(std::string_view name) noexcept;
    /// Drops all names; the number of buckets stays.
    void Empty() noexcept;
    bool IsEmpty() const noexcept { return count_ == 0; }
    const Node* GetFirst() const noexcept { return head_; }

private:
    std::uint32_t Hash(std::string_view name) const noexcept;
    bool Equal(const Node& node, std::uint32_t hash, std::string_view name) const noexcept;
    const Node* Find(std::string_view name) const noexcept;
    std::size_t BucketOf(std::uint32_t hash) const noexcept { return hash % buckets_.size(); }
    /// The link that leads to a bucket's first name, or would.
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
