// Replaced by the thesaurus service.
