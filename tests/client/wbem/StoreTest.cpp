#include <gtest/gtest.h>

#include "client/wbem/TAnswerStore.h"
#include "embedded/load/TLoadReport.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {
namespace {

const std::string kClass = "<CLASS NAME=\"A\"><PROPERTY NAME=\"Id\" TYPE=\"string\"><QUALIFIER NAME=\"Key\" "
                           "TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY></CLASS>";

std::string Instance(const std::string& id)
{
    return "<INSTANCE CLASSNAME=\"A\"><PROPERTY NAME=\"Id\" TYPE=\"string\"><VALUE>" + id + "</VALUE></PROPERTY></INSTANCE>";
}

/// How many instances the answers have from that one on.
std::size_t CountFrom(const TAnswerStore& store, std::size_t first)
{
    TLoadSession session(TInMemNamespace::Create("root/x"), "store");
    store.Load(first, session);
    return session.Commit().instances;
}

void Add(TAnswerStore& store, const std::string& text)
{
    store.Begin("an answer");
    store.Append(text.substr(0, text.size() / 2));
    store.Append(text.substr(text.size() / 2));
    store.End();
}

TEST(AnswerStoreTest, AnswersAreLoadedOneByOneFromMemoryAndFromTheFile)
{
    TAnswerStore store;
    Add(store, kClass);
    const std::string large(TSpooledText::kMostInMemory * 2 / 3, 'x');
    for (const std::string id : {"1", "2", "3"}) {
        Add(store, Instance(large + id));  // together more than stays in memory
    }
    Add(store, Instance("4"));
    EXPECT_EQ(5u, store.CountAnswers());
    EXPECT_EQ(4u, CountFrom(store, 0));
}

TEST(AnswerStoreTest, WhatIsDroppedIsNotLoaded)
{
    TAnswerStore store;
    Add(store, kClass);
    Add(store, Instance("1"));
    store.Begin("half an answer");
    store.Append("<INSTANCE CLASS");
    store.DropUnfinished();
    Add(store, Instance("2"));
    Add(store, "no XML");
    EXPECT_EQ(4u, store.CountAnswers());
    store.KeepFirst(3);
    EXPECT_EQ(2u, CountFrom(store, 0));
    Add(store, Instance("3"));
    EXPECT_EQ(3u, CountFrom(store, 0));
}

}  // namespace
}  // namespace NORVZEL20
