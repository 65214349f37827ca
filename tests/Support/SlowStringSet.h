/// \file
/// A second, slow `StringSet`: what it shows and in which order, written out plainly.
#pragma once

#include <cstdint>
#include <map>
#include <string>
#include <string_view>
#include <vector>

namespace Support {

/// The names of one table, bucket by bucket; the walk goes through the buckets in ascending order.
class SlowNameTable {
public:
    bool Contains(const std::string& name) const {
        const auto bucket = buckets_.find(BucketOf(name));
        if (bucket == buckets_.end()) {
            return false;
        }
        for (const std::string& present : bucket->second) {
            if (present == name) {
                return true;
            }
        }
        return false;
    }

    void Add(const std::string& name) {
        if (Contains(name)) {
            return;
        }
        if (count_ + 1 > bucketCount_) {
            Grow(FirstPrimeFrom(count_ + 1));
        }
        std::vector<std::string>& bucket = buckets_[BucketOf(name)];
        bucket.insert(bucket.begin() + (bucket.empty() ? 0 : 1), name);
        ++count_;
    }

    void Remove(const std::string& name) {
        if (!Contains(name)) {
            return;
        }
        const std::uint64_t index = BucketOf(name);
        std::erase(buckets_[index], name);
        if (buckets_[index].empty()) {
            buckets_.erase(index);
        }
        --count_;
    }

    void Empty() {
        buckets_.clear();
        count_ = 0;
    }

    std::vector<std::string> Walk() const {
        std::vector<std::string> names;
        for (const auto& [index, bucket] : buckets_) {
            names.insert(names.end(), bucket.begin(), bucket.end());
        }
        return names;
    }

    std::uint64_t GetBucketCount() const { return bucketCount_; }

    static std::uint32_t Hash(std::string_view name) {
        std::uint32_t hash = 5381;
        for (const char c : name) {
            const int byte = static_cast<unsigned char>(c);
            hash = hash * 33u + static_cast<std::uint32_t>(byte < 128 ? byte : byte - 256);
        }
        return hash;
    }

private:
    static std::uint64_t FirstPrimeFrom(std::uint64_t least) {
        for (const std::uint64_t prime :
             {53u,        97u,        193u,       389u,       769u,        1543u,      3079u,
              6151u,      12289u,     24593u,     49157u,     98317u,      196613u,    393241u,
              786433u,    1572869u,   3145739u,   6291469u,   12582917u,   25165843u,  50331653u,
              100663319u, 201326611u, 402653189u, 805306457u, 1610612741u, 3221225473u}) {
            if (prime >= least) {
                return prime;
            }
        }
        return 4294967291u;
    }

    std::uint64_t BucketOf(const std::string& name) const { return Hash(name) % bucketCount_; }

    void Grow(std::uint64_t bucketCount) {
        const std::vector<std::string> names = Walk();
        buckets_.clear();
        bucketCount_ = bucketCount;
        for (const std::string& name : names) {
            std::vector<std::string>& bucket = buckets_[BucketOf(name)];
            bucket.insert(bucket.begin(), name);
        }
    }

    std::map<std::uint64_t, std::vector<std::string>> buckets_;
    std::uint64_t bucketCount_ = FirstPrimeFrom(100);
    std::uint64_t count_ = 0;
};

class SlowStringSet {
public:
    void Add(const std::string& name) {
        ignoringCase_.Add(Upper(name));
        keepingCase_.Add(name);
    }
    bool Contains(const std::string& name) const { return keepingCase_.Contains(name); }
    bool IContains(const std::string& name) const { return ignoringCase_.Contains(Upper(name)); }
    void Remove(const std::string& name) {
        ignoringCase_.Remove(Upper(name));
        keepingCase_.Remove(name);
    }
    bool IsEmpty() const { return Walk().empty(); }
    void Empty() { keepingCase_.Empty(); }
    std::vector<std::string> Walk() const { return keepingCase_.Walk(); }

private:
    static std::string Upper(std::string name) {
        for (char& c : name) {
            if (c >= 'a' && c <= 'z') {
                c = static_cast<char>(c - 32);
            }
        }
        return name;
    }

    SlowNameTable ignoringCase_;
    SlowNameTable keepingCase_;
};

} // namespace Support
