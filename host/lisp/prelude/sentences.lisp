;;; What Lisp says in the host's name, in the person's language.

(in-package "TESSEL-HOST")

(defvar *interrupted* "" "What is said of an interrupt, which may come while the host's own code must not run.")
(defvar *stack-overflow* "" "What is said when there is little room to find words.")
(defvar *memory-exhausted* "" "The same.")

(defun put-in (thing)
  (if (integerp thing)
      (format nil "~D" thing)
      (princ-to-string thing)))

(defun translated (english &optional (first nil first-given) (second nil second-given))
  "The sentence with what is put into its places {}. Translators find it by the name of this function."
  (%translated english (and first-given (put-in first)) (and second-given (put-in second))))

(defun find-words ()
  (setf *interrupted* (translated "Lisp was interrupted.")
        *stack-overflow* (translated "stack overflow: the recursion is endless or too deep.")
        *memory-exhausted* (translated "the memory for Lisp is exhausted.")))
