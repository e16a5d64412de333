;;; Functions that an application calls by name.

(in-package "TESSEL-HOST")

(defconstant +most-values+ 100000 "A list that is longer is circular, or a mistake.")

(defun plain-value (value)
  "A string, an integer of 32 bits, a double, T or NIL."
  (typecase value
    (string value)
    (null nil)
    ((eql t) t)
    (symbol (symbol-name value))
    (character (string value))
    ((signed-byte 32) value)
    (real (coerce value 'double-float))
    (t (printed value))))

(defun plain-values (value)
  "The values of a list in their order, those of the lists within it in their places."
  (let ((found '()) (count 0) (waiting (list value)))
    (loop while waiting
          do (let ((next (pop waiting)))
               (cond ((> (incf count) +most-values+)
                      (error "~A" (translated "The answer holds more than {} values, or is circular."
                                              +most-values+)))
                     ((consp next)
                      (when (cdr next)
                        (push (cdr next) waiting))
                      (push (car next) waiting))
                     (t (push (plain-value next) found)))))
    (nreverse found)))

(defun function-named (name)
  (let ((symbol (find-symbol (string-upcase name) *package*)))
    (if (and symbol (fboundp symbol) (not (macro-function symbol)) (not (special-operator-p symbol)))
        (fdefinition symbol)
        (error "~A" (translated "There is no Lisp function {}." name)))))

(defun invoke (name arguments)
  (call-guarded
   (lambda ()
     (let ((value (apply (function-named name) arguments)))
       (if (or (null value) (eq value *nothing*))
           '()
           (plain-values value))))))

(defun names-something-p (symbol)
  (or (fboundp symbol) (boundp symbol) (special-operator-p symbol)))

(defun typed-plainly (symbol)
  "Its name as it is typed without bars, or nil."
  (let ((name (symbol-name symbol)))
    (and (notany #'lower-case-p name)
         (notany (lambda (character) (find character " ()\"'`,;|\\")) name)
         (string-downcase name))))

(defun symbols-beginning (beginning)
  "What the Tab key offers: a line for each symbol that can be typed and names something."
  (call-guarded
   (lambda ()
     (let ((names '()) (length (length beginning)))
       (do-symbols (symbol *user-package*)
         (let ((name (and (names-something-p symbol) (typed-plainly symbol))))
           (when (and name (<= length (length name)) (string-equal beginning name :end2 length))
             (pushnew name names :test #'string=))))
       (format nil "~{~A~%~}" (sort names #'string<))))))
