;;; A sample Lisp application: conversion of units, as a draughtsman needs them.

(defparameter *units*
  ;; A unit, the kind of quantity it measures, and its size in the base unit of that kind.
  '((mm length 1/1000) (m length 1) (km length 1000)
    (inch length 254/10000) (foot length 3048/10000) (mile length 1609344/1000)
    (g mass 1/1000) (kg mass 1) (ounce mass 28349523125/1000000000000) (pound mass 45359237/100000000)
    (n force 1) (kn force 1000) (lbf force 44482216152605/10000000000000)
    (pa pressure 1) (kpa pressure 1000) (mpa pressure 1000000) (bar pressure 100000)))

(defun find-unit (name)
  (or (assoc (string name) *units* :test #'string-equal)
      (error "There is no unit ~a; (units) lists them." name)))

(defun convert (number from to)
  "NUMBER of the unit FROM in the unit TO, exactly if the number is exact: (convert 1 'inch 'mm)."
  (destructuring-bind (from-name from-kind from-size) (find-unit from)
    (destructuring-bind (to-name to-kind to-size) (find-unit to)
      (unless (eq from-kind to-kind)
        (error "~(~a~) measures ~(~a~) and ~(~a~) measures ~(~a~)." from-name from-kind to-name to-kind))
      (/ (* number from-size) to-size))))

(defun units-number (number)
  "Four significant digits, or all that stand before the point; at most nine after it, to keep the columns."
  (let* ((exponent (floor (log number 10)))
         (decimals (max 0 (min 9 (- 3 exponent))))
         (text (format nil "~,vf" decimals (coerce number 'double-float))))
    (string-right-trim "." (string-right-trim "0" text))))

(defun units (&optional (kind 'length))
  "Prints how the units of a kind (length, mass, force, pressure) convert into one another."
  (let ((names (loop for (name its-kind) in *units*
                     when (string-equal kind its-kind) collect name)))
    (when (null names)
      (error "There are no units of ~(~a~); try length, mass, force or pressure." kind))
    (format t "~8a~{~12@a~}~%" "" (mapcar #'string-downcase names))
    (dolist (from names)
      (format t "1 ~6a" (string-downcase from))
      (dolist (to names)
        (format t "~12@a" (units-number (convert 1 from to))))
      (terpri)))
  (princ))

(format t "~&Units: type (convert 1 'inch 'mm) to convert, (units 'mass) for a table of length, mass, force or pressure.~%")
