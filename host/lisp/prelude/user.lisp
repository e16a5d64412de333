;;; The system's own functions, as a person or an application calls them.

(in-package "TESSEL-HOST")

(defun tessel:load (file &key (if-does-not-exist :error) &allow-other-keys)
  "Loads a Lisp file, as source or compiled, and lists it as loaded into the document."
  (check-type file (or string pathname))
  (load-file (if (pathnamep file) (namestring file) (coerce file 'simple-string)) if-does-not-exist))

(defun tessel:qz-load (file &optional a b)
  "What the Lisp development environment calls to load a file."
  (declare (ignore a b))
  (tessel:load file))

(defun tessel:_internal-load-all-file (file &optional a b c d)
  "Loads a file with everything that belongs to it, which for the kinds of this host is the file alone."
  (declare (ignore a b c d))
  (tessel:load file))

(defun tessel:qz-unload-rpk (name)
  (format t "~&~A~%" (translated "No packaged application named {} is loaded." name))
  nil)

(defun tessel:princ (&optional (object nil given) (stream *standard-output*))
  "Without an argument: nothing is printed, not even the value."
  (cond (given
         (cl:princ object stream)
         ;; Shown at once: what follows may take its time.
         (finish-output stream)
         object)
        (t *nothing*)))

(defun tessel:prompt (text)
  (write-string text *standard-output*)
  (finish-output *standard-output*)
  nil)

(defun refuse-to-quit (&rest arguments)
  (declare (ignore arguments))
  (error "~A" (translated "Lisp cannot end the host; type QUIT without parentheses to do so.")))

(defun tessel:quit (&rest arguments)
  (apply #'refuse-to-quit arguments))

(defun tessel:exit (&rest arguments)
  (apply #'refuse-to-quit arguments))

;;; These would end the process in the middle of the host's work. The package is left open: Lisp itself makes symbols
;;; in it when it signals some errors for the first time.
(ext:package-lock "SI" nil)
(dolist (name '(si::exit ext:quit))
  (setf (fdefinition name) #'refuse-to-quit))

;;; Endless recursion is an error like others: it cannot be continued with more stack.
(setf (fdefinition 'si::stack-error-handler)
      (lambda (continue-text condition arguments)
        (declare (ignore continue-text))
        (unwind-protect (apply #'error condition arguments)
          (%restore-stack-limits))))

;;; A user who defines one of these by mistake is told, as with the functions of Lisp.
(ext:package-lock "TESSEL" t)

;;; Outside of an evaluation an interrupt waits.
(setf ext:*interrupts-enabled* nil)
