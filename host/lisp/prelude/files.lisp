;;; Loading files, form by form, so that an error can name the line.

(in-package "TESSEL-HOST")

(defconstant +deepest-loading+ 100 "Files within files; a file that loads itself ends here.")

(defmacro noting-places (&body body)
  "Notes where an error happens, before the stack is unwound. The innermost file sees it first."
  `(handler-bind ((serious-condition (lambda (condition)
                                       (unless (eq condition (car *placed-error*))
                                         (setf *placed-error* (cons condition (current-place)))))))
     ,@body))

(defmacro do-source-forms ((form text) &body body)
  "Reads the forms one after the other, so that each is read as those before it demand, and keeps *PLACE*."
  `(let ((position 0) (counted 0) (,form nil))
     (loop
       (let ((start (form-start ,text position)))
         (unless start
           (return))
         (incf (cdr *place*) (count #\Newline ,text :start counted :end start))
         (setf counted start)
         (multiple-value-setq (,form position) (next-form ,text start ,text))
         (when (eq ,form ,text)
           (return))
         ,@body))))

(defun run-source (text)
  (do-source-forms (form text)
    (eval form)))

;;; Compiled Lisp is a row of (line . byte code), written and read in the standard syntax, whatever the user has set.
(defun compile-source (text)
  (with-output-to-string (compiled)
    ;; Otherwise every function would carry the path of the file on the machine that compiled it; and without the
    ;; byte-code compiler in place, defining forms expand into calls of the native one.
    (let ((ext:*source-location* nil) (ext:*bytecodes-compiler* t) (*package* *package*) (*readtable* *readtable*))
      (do-source-forms (form text)
        (let ((code (si:eval-with-env form nil nil nil :load-toplevel)))
          (with-standard-io-syntax
            (write (cons (cdr *place*) code) :stream compiled :circle t :readably t)
            (terpri compiled)))))))

(defun run-compiled (text)
  (let ((position 0) (end (length text)) (record nil))
    (loop
      (multiple-value-setq (record position)
        (with-standard-io-syntax (read-from-string text nil nil :start (min position end))))
      (when (null record)
        (return))
      (setf (cdr *place*) (car record))
      (funcall (cdr record)))))

(defun run-file (path kind name text)
  (let ((*loading-depth* (1+ *loading-depth*))
        (*package* *package*) (*readtable* *readtable*)
        (*load-pathname* (ignore-errors (pathname name)))
        (*load-truename* (ignore-errors (truename name))))
    (let ((*place* (cons name 1)))
      (when (> *loading-depth* +deepest-loading+)
        (error "~A" (translated "Files load one another more than {} deep." +deepest-loading+)))
      (ecase kind
        (:source (run-source text))
        (:compiled (run-compiled text))))
    (%record-loaded path)
    t))

(defun load-found (path if-does-not-exist)
  (destructuring-bind (kind name &optional text) (%read-file path)
    (cond (text (run-file path kind name text))
          ((and (eq kind :missing) (null if-does-not-exist)) nil)
          (t (error "~A" name)))))

(defun load-file (path if-does-not-exist)
  (let ((open (%files-open)) (*outermost-file* (or *outermost-file* path)))
    (unwind-protect (noting-places (load-found path if-does-not-exist))
      (%end-files open))))

(defun compile-text (name text)
  (call-guarded
   (lambda ()
     (let ((*place* (cons name 1)))
       (noting-places (compile-source text))))))
