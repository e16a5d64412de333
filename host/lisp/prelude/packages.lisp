;;; The packages of the host's Lisp. TESSEL offers the system's own functions; TESSEL-HOST is how they are made.
;;; What a person types is read in TESSEL-USER, which every session makes anew.

(defpackage "TESSEL"
  (:use)
  (:export "LOAD" "PRINC" "PROMPT" "QUIT" "EXIT" "QZ-LOAD" "QZ-UNLOAD-RPK" "_INTERNAL-LOAD-ALL-FILE"))

(in-package "TESSEL-HOST")

(setf *load-verbose* nil
      *compile-verbose* nil
      ext:*default-external-format* :utf-8)

(defvar *user-package* nil "The package in which the next typed line is read.")
(defvar *user-readtable* nil "The readtable of the session.")

;;; Not every host loads compiled and packaged Lisp.
(defparameter *always-offered* '(tessel:load tessel:princ tessel:prompt tessel:quit tessel:exit tessel:qz-load))
(defparameter *offered-when-removing* '(tessel:qz-unload-rpk tessel:_internal-load-all-file))

(defun begin-session (removing heap-bytes)
  "Forgets what an earlier session in this process has defined."
  (ext:set-limit 'ext:heap-size heap-bytes)
  (let ((old (find-package "TESSEL-USER")))
    ;; A new name, not a deletion: what the old session left running may still print its symbols.
    (when old
      (rename-package old (gensym "ENDED-SESSION-"))))
  (let ((package (make-package "TESSEL-USER" :use '("COMMON-LISP"))))
    (shadowing-import (if removing (append *always-offered* *offered-when-removing*) *always-offered*) package)
    (setf *user-package* package
          *user-readtable* (copy-readtable nil))))
