;;; What the package holds, and what would be loaded first.
(:name "survey" :version "1.0" :start "survey.lsp"
 :description "Adds up the legs of a survey. Tessel knows packaged Lisp applications but does not load them.")
