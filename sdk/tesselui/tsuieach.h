// Walking an NSArray with a range-based `for`, which every Objective-C++ compiler understands (GCC knows no
// `for (... in ...)` there):
//
//     for (NSString* path : tsuiEach<NSString*>(paths))
//
// nil is walked like an empty array. The array must not change meanwhile; it is kept alive.
#pragma once

#import <Foundation/NSArray.h>

template <class Object> class TsUIArrayRange
{
public:
    class Iterator
    {
    public:
        Iterator(NSArray* array, NSUInteger index) : mArray(array), mIndex(index) {}
        Object operator*() const { return [mArray objectAtIndex:mIndex]; }
        Iterator& operator++()
        {
            ++mIndex;
            return *this;
        }
        bool operator!=(const Iterator& other) const { return mIndex != other.mIndex; }

    private:
        NSArray* mArray;
        NSUInteger mIndex;
    };

    explicit TsUIArrayRange(NSArray* array) : mArray([array retain]) {}
    ~TsUIArrayRange() { [mArray release]; }
    TsUIArrayRange(const TsUIArrayRange&) = delete;
    TsUIArrayRange& operator=(const TsUIArrayRange&) = delete;

    Iterator begin() const { return Iterator(mArray, 0); }
    Iterator end() const { return Iterator(mArray, [mArray count]); }

private:
    NSArray* mArray;
};

template <class Object> TsUIArrayRange<Object> tsuiEach(NSArray* array)
{
    return TsUIArrayRange<Object>(array);
}
