// SPDX-License-Identifier: MIT
#pragma once

#include <vector>

#include "names/NamesCatalogImpl.h"
#include "ostinet/NamesCatalog.h"
#include "ostinet/core/SortedVector.h"

namespace Ostinet::Impl {

// What the catalog is searched for. Texts are compared code unit by code unit, and a document
// whose file is gone matches nothing.

/// The master document of a model: the first that its manufacturer itself wrote, else the first.
class FindMasterFunc : public NamesCatalogImpl::Func {
 public:
  FindMasterFunc(UString const& manufacturer, UString const& model)
      : manufacturer_(manufacturer), model_(model) {}
  bool operator()(NameDocumentDigest const& digest) override;
  Names const& GetResult() const { return result_; }

 private:
  UString const& manufacturer_;
  UString const& model_;
  Names result_;
};

/// A search that hands on what it finds for a model, as it goes.
class CollectingSearch : public NamesCatalogImpl::Func {
 public:
  CollectingSearch(UString const& manufacturer, UString const& model, std::vector<Names>& out)
      : manufacturer_(manufacturer), model_(model), out_(out) {}

 protected:
  UString const& manufacturer_;
  UString const& model_;
  std::vector<Names>& out_;
};

/// All master documents of a model, one for each entry that matches.
class FindMastersFunc : public CollectingSearch {
 public:
  using CollectingSearch::CollectingSearch;
  bool operator()(NameDocumentDigest const& digest) override;
};

/// The patch lists of every document that extends a model, of its first entry that matches.
class FindOverridesFunc : public CollectingSearch {
 public:
  using CollectingSearch::CollectingSearch;
  bool operator()(NameDocumentDigest const& digest) override;
};

/// The first document that defines a standard mode.
class FindStdFunc : public NamesCatalogImpl::Func {
 public:
  explicit FindStdFunc(UString const& name) : name_(name) {}
  bool operator()(NameDocumentDigest const& digest) override;
  Names const& GetResult() const { return result_; }

 private:
  UString const& name_;
  Names result_;
};

/// Each standard mode, in its first document.
class FindStdsFunc : public NamesCatalogImpl::Func {
 public:
  explicit FindStdsFunc(std::vector<Names>& out) : out_(out) {}
  bool operator()(NameDocumentDigest const& digest) override;

 private:
  std::vector<Names>& out_;
  sorted_vector_set<UString> seen_;
};

/// The library's own questions: a document that cannot be read is passed over, so that one bad
/// file never stops a poll or a start.
Names FindMasterNames(UString const& manufacturer, UString const& model);
Names FindStandardModeNames(UString const& name);

}  // namespace Ostinet::Impl
